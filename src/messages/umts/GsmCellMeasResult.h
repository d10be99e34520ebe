// Measurement of one neighbouring GSM cell.
//
// Written by messagegen from schema/umts.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class GsmCellMeasResult final : public Message<GsmCellMeasResult> {
 public:
  static constexpr std::string_view className = "GsmCellMeasResult";

  [[nodiscard]] std::uint32_t arfcn() const noexcept { return _arfcn; }
  void setArfcn(std::uint32_t arfcn) noexcept {
    _arfcn = arfcn;
    _has.set(0);
  }
  void setHasArfcn(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasArfcn() const noexcept { return _has.test(0); }

  [[nodiscard]] std::uint32_t bsic() const noexcept { return _bsic; }
  void setBsic(std::uint32_t bsic) noexcept {
    _bsic = bsic;
    _has.set(1);
  }
  void setHasBsic(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasBsic() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t rxlev() const noexcept { return _rxlev; }
  void setRxlev(std::uint32_t rxlev) noexcept {
    _rxlev = rxlev;
    _has.set(2);
  }
  void setHasRxlev(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasRxlev() const noexcept { return _has.test(2); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint32>(1, "arfcn", &Self::_arfcn, 0),
        numberField<NumberKind::uint32>(2, "bsic", &Self::_bsic, 1),
        numberField<NumberKind::uint32>(3, "rxlev", &Self::_rxlev, 2));
  }

 private:
  friend class Message<GsmCellMeasResult>;

  std::uint32_t _arfcn = 0;
  std::uint32_t _bsic = 0;
  std::uint32_t _rxlev = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<GsmCellMeasResult>;

}  // namespace vespscope
