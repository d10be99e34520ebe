// Idle-mode measurement of the serving GSM cell.
//
// Written by messagegen from schema/gsm.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class KCellularGsmIdleScellMeasurement final : public Message<KCellularGsmIdleScellMeasurement> {
 public:
  static constexpr std::string_view className = "KCellularGsmIdleScellMeasurement";

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
    _has.set(3);
  }
  void setHasScellArfcn(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasScellArfcn() const noexcept { return _has.test(3); }

  [[nodiscard]] std::uint32_t simplifiedL1State() const noexcept { return _simplifiedL1State; }
  void setSimplifiedL1State(std::uint32_t simplifiedL1State) noexcept {
    _simplifiedL1State = simplifiedL1State;
    _has.set(4);
  }
  void setHasSimplifiedL1State(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasSimplifiedL1State() const noexcept { return _has.test(4); }

  [[nodiscard]] std::uint32_t currentAntenna() const noexcept { return _currentAntenna; }
  void setCurrentAntenna(std::uint32_t currentAntenna) noexcept {
    _currentAntenna = currentAntenna;
    _has.set(1);
  }
  void setHasCurrentAntenna(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasCurrentAntenna() const noexcept { return _has.test(1); }

  [[nodiscard]] std::int32_t idleRxlevDBm() const noexcept { return _idleRxlevDBm; }
  void setIdleRxlevDBm(std::int32_t idleRxlevDBm) noexcept {
    _idleRxlevDBm = idleRxlevDBm;
    _has.set(2);
  }
  void setHasIdleRxlevDBm(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasIdleRxlevDBm() const noexcept { return _has.test(2); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        numberField<NumberKind::uint32>(2, "scell_arfcn", &Self::_scellArfcn, 3),
        numberField<NumberKind::uint32>(3, "simplified_l1_state", &Self::_simplifiedL1State, 4),
        numberField<NumberKind::uint32>(4, "current_antenna", &Self::_currentAntenna, 1),
        numberField<NumberKind::sint32>(5, "idle_rxlev_dBm", &Self::_idleRxlevDBm, 2));
  }

 private:
  friend class Message<KCellularGsmIdleScellMeasurement>;

  std::uint64_t _timestamp = 0;
  std::uint32_t _scellArfcn = 0;
  std::uint32_t _simplifiedL1State = 0;
  std::uint32_t _currentAntenna = 0;
  std::int32_t _idleRxlevDBm = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularGsmIdleScellMeasurement>;

}  // namespace vespscope
