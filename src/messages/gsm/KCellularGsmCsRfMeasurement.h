// Measurement of the serving GSM cell during a circuit-switched connection.
//
// Written by messagegen from schema/gsm.proto; change it there.
// clang-format off
#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class KCellularGsmCsRfMeasurement final : public Message<KCellularGsmCsRfMeasurement> {
 public:
  static constexpr std::string_view className = "KCellularGsmCsRfMeasurement";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  [[nodiscard]] std::uint32_t scellArfcn() const noexcept { return _scellArfcn; }
  void setScellArfcn(std::uint32_t scellArfcn) noexcept {
    _scellArfcn = scellArfcn;
    _has.set(4);
  }
  void setHasScellArfcn(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasScellArfcn() const noexcept { return _has.test(4); }

  [[nodiscard]] std::uint32_t simplifiedL1State() const noexcept { return _simplifiedL1State; }
  void setSimplifiedL1State(std::uint32_t simplifiedL1State) noexcept {
    _simplifiedL1State = simplifiedL1State;
    _has.set(6);
  }
  void setHasSimplifiedL1State(bool present) noexcept { _has.set(6, present); }
  [[nodiscard]] bool hasSimplifiedL1State() const noexcept { return _has.test(6); }

  [[nodiscard]] std::uint32_t currentAntenna() const noexcept { return _currentAntenna; }
  void setCurrentAntenna(std::uint32_t currentAntenna) noexcept {
    _currentAntenna = currentAntenna;
    _has.set(3);
  }
  void setHasCurrentAntenna(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasCurrentAntenna() const noexcept { return _has.test(3); }

  [[nodiscard]] std::size_t csTxPwrsCount() const noexcept { return _csTxPwrs.size(); }
  [[nodiscard]] std::span<const std::int32_t> csTxPwrs() const noexcept { return _csTxPwrs.values(); }
  void clearCsTxPwrs() noexcept { _csTxPwrs.clear(); }
  void addCsTxPwr(std::int32_t csTxPwr) { _csTxPwrs.add(csTxPwr); }
  [[nodiscard]] std::int32_t csTxPwrAtIndex(std::size_t index) const { return _csTxPwrs.at(index); }
  void setCsTxPwrs(const std::int32_t* values, std::size_t count) { _csTxPwrs.assign(values, count); }

  [[nodiscard]] std::uint32_t csRxlevSub() const noexcept { return _csRxlevSub; }
  void setCsRxlevSub(std::uint32_t csRxlevSub) noexcept {
    _csRxlevSub = csRxlevSub;
    _has.set(1);
  }
  void setHasCsRxlevSub(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasCsRxlevSub() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t csRxqualSub() const noexcept { return _csRxqualSub; }
  void setCsRxqualSub(std::uint32_t csRxqualSub) noexcept {
    _csRxqualSub = csRxqualSub;
    _has.set(2);
  }
  void setHasCsRxqualSub(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasCsRxqualSub() const noexcept { return _has.test(2); }

  [[nodiscard]] std::uint32_t scellBand() const noexcept { return _scellBand; }
  void setScellBand(std::uint32_t scellBand) noexcept {
    _scellBand = scellBand;
    _has.set(5);
  }
  void setHasScellBand(bool present) noexcept { _has.set(5, present); }
  [[nodiscard]] bool hasScellBand() const noexcept { return _has.test(5); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        numberField<NumberKind::uint32>(2, "scell_arfcn", &Self::_scellArfcn, 4),
        numberField<NumberKind::uint32>(3, "simplified_l1_state", &Self::_simplifiedL1State, 6),
        numberField<NumberKind::uint32>(4, "current_antenna", &Self::_currentAntenna, 3),
        numberListField<NumberKind::sint32>(5, "cs_tx_pwr", &Self::_csTxPwrs),
        numberField<NumberKind::uint32>(6, "cs_rxlev_sub", &Self::_csRxlevSub, 1),
        numberField<NumberKind::uint32>(7, "cs_rxqual_sub", &Self::_csRxqualSub, 2),
        numberField<NumberKind::uint32>(8, "scell_band", &Self::_scellBand, 5));
  }

 private:
  friend class Message<KCellularGsmCsRfMeasurement>;

  std::uint64_t _timestamp = 0;
  NumberList<std::int32_t> _csTxPwrs;
  std::uint32_t _scellArfcn = 0;
  std::uint32_t _simplifiedL1State = 0;
  std::uint32_t _currentAntenna = 0;
  std::uint32_t _csRxlevSub = 0;
  std::uint32_t _csRxqualSub = 0;
  std::uint32_t _scellBand = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularGsmCsRfMeasurement>;

}  // namespace vespscope
