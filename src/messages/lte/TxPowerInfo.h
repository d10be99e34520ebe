// Transmit power in one subframe.
//
// Written by messagegen from schema/lte.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class TxPowerInfo final : public Message<TxPowerInfo> {
 public:
  static constexpr std::string_view className = "TxPowerInfo";

  [[nodiscard]] std::int32_t pucchTxPower() const noexcept { return _pucchTxPower; }
  void setPucchTxPower(std::int32_t pucchTxPower) noexcept {
    _pucchTxPower = pucchTxPower;
    _has.set(0);
  }
  void setHasPucchTxPower(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasPucchTxPower() const noexcept { return _has.test(0); }

  [[nodiscard]] std::int32_t puschTxPower() const noexcept { return _puschTxPower; }
  void setPuschTxPower(std::int32_t puschTxPower) noexcept {
    _puschTxPower = puschTxPower;
    _has.set(1);
  }
  void setHasPuschTxPower(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasPuschTxPower() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t subframeIndex() const noexcept { return _subframeIndex; }
  void setSubframeIndex(std::uint32_t subframeIndex) noexcept {
    _subframeIndex = subframeIndex;
    _has.set(2);
  }
  void setHasSubframeIndex(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasSubframeIndex() const noexcept { return _has.test(2); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::sint32>(1, "pucch_tx_power", &Self::_pucchTxPower, 0),
        numberField<NumberKind::sint32>(2, "pusch_tx_power", &Self::_puschTxPower, 1),
        numberField<NumberKind::uint32>(3, "subframe_index", &Self::_subframeIndex, 2));
  }

 private:
  friend class Message<TxPowerInfo>;

  std::int32_t _pucchTxPower = 0;
  std::int32_t _puschTxPower = 0;
  std::uint32_t _subframeIndex = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<TxPowerInfo>;

}  // namespace vespscope
