// Connected-mode DRX configuration of the serving LTE cell (3GPP TS 36.321 5.7).
//
// Written by messagegen from schema/lte.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"
#include "messages/lte/LteRrcState.h"

namespace vespscope {

class KCellularLteCdrxConfig final : public Message<KCellularLteCdrxConfig> {
 public:
  static constexpr std::string_view className = "KCellularLteCdrxConfig";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  [[nodiscard]] std::uint32_t cellStatus() const noexcept { return _cellStatus; }
  void setCellStatus(std::uint32_t cellStatus) noexcept {
    _cellStatus = cellStatus;
    _has.set(2);
  }
  void setHasCellStatus(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasCellStatus() const noexcept { return _has.test(2); }

  [[nodiscard]] std::uint32_t onDurationMs() const noexcept { return _onDurationMs; }
  void setOnDurationMs(std::uint32_t onDurationMs) noexcept {
    _onDurationMs = onDurationMs;
    _has.set(7);
  }
  void setHasOnDurationMs(bool present) noexcept { _has.set(7, present); }
  [[nodiscard]] bool hasOnDurationMs() const noexcept { return _has.test(7); }

  [[nodiscard]] std::uint32_t drxInactivityMs() const noexcept { return _drxInactivityMs; }
  void setDrxInactivityMs(std::uint32_t drxInactivityMs) noexcept {
    _drxInactivityMs = drxInactivityMs;
    _has.set(3);
  }
  void setHasDrxInactivityMs(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasDrxInactivityMs() const noexcept { return _has.test(3); }

  [[nodiscard]] std::uint32_t drxRetxTimerMs() const noexcept { return _drxRetxTimerMs; }
  void setDrxRetxTimerMs(std::uint32_t drxRetxTimerMs) noexcept {
    _drxRetxTimerMs = drxRetxTimerMs;
    _has.set(4);
  }
  void setHasDrxRetxTimerMs(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasDrxRetxTimerMs() const noexcept { return _has.test(4); }

  [[nodiscard]] std::uint32_t longDrxCycleMs() const noexcept { return _longDrxCycleMs; }
  void setLongDrxCycleMs(std::uint32_t longDrxCycleMs) noexcept {
    _longDrxCycleMs = longDrxCycleMs;
    _has.set(6);
  }
  void setHasLongDrxCycleMs(bool present) noexcept { _has.set(6, present); }
  [[nodiscard]] bool hasLongDrxCycleMs() const noexcept { return _has.test(6); }

  [[nodiscard]] std::uint32_t shortDrxCycleMs() const noexcept { return _shortDrxCycleMs; }
  void setShortDrxCycleMs(std::uint32_t shortDrxCycleMs) noexcept {
    _shortDrxCycleMs = shortDrxCycleMs;
    _has.set(9);
  }
  void setHasShortDrxCycleMs(bool present) noexcept { _has.set(9, present); }
  [[nodiscard]] bool hasShortDrxCycleMs() const noexcept { return _has.test(9); }

  [[nodiscard]] std::uint32_t drxShortCycleNum() const noexcept { return _drxShortCycleNum; }
  void setDrxShortCycleNum(std::uint32_t drxShortCycleNum) noexcept {
    _drxShortCycleNum = drxShortCycleNum;
    _has.set(5);
  }
  void setHasDrxShortCycleNum(bool present) noexcept { _has.set(5, present); }
  [[nodiscard]] bool hasDrxShortCycleNum() const noexcept { return _has.test(5); }

  // A value of LteRrcState, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t rrcState() const noexcept { return hasRrcState() ? _rrcState : LteRrcState::firstDeclared; }
  void setRrcState(std::int32_t rrcState) noexcept {
    _rrcState = rrcState;
    _has.set(8);
  }
  void setHasRrcState(bool present) noexcept { _has.set(8, present); }
  [[nodiscard]] bool hasRrcState() const noexcept { return _has.test(8); }

  [[nodiscard]] std::uint32_t cdrxConfigStatus() const noexcept { return _cdrxConfigStatus; }
  void setCdrxConfigStatus(std::uint32_t cdrxConfigStatus) noexcept {
    _cdrxConfigStatus = cdrxConfigStatus;
    _has.set(1);
  }
  void setHasCdrxConfigStatus(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasCdrxConfigStatus() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t transmissionMode() const noexcept { return _transmissionMode; }
  void setTransmissionMode(std::uint32_t transmissionMode) noexcept {
    _transmissionMode = transmissionMode;
    _has.set(10);
  }
  void setHasTransmissionMode(bool present) noexcept { _has.set(10, present); }
  [[nodiscard]] bool hasTransmissionMode() const noexcept { return _has.test(10); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        numberField<NumberKind::uint32>(2, "cell_status", &Self::_cellStatus, 2),
        numberField<NumberKind::uint32>(3, "on_duration_ms", &Self::_onDurationMs, 7),
        numberField<NumberKind::uint32>(4, "drx_inactivity_ms", &Self::_drxInactivityMs, 3),
        numberField<NumberKind::uint32>(5, "drx_retx_timer_ms", &Self::_drxRetxTimerMs, 4),
        numberField<NumberKind::uint32>(7, "long_drx_cycle_ms", &Self::_longDrxCycleMs, 6),
        numberField<NumberKind::uint32>(10, "short_drx_cycle_ms", &Self::_shortDrxCycleMs, 9),
        numberField<NumberKind::uint32>(11, "drx_short_cycle_num", &Self::_drxShortCycleNum, 5),
        enumerationField(12, "rrc_state", &Self::_rrcState, 8, LteRrcState::names),
        numberField<NumberKind::uint32>(13, "cdrx_config_status", &Self::_cdrxConfigStatus, 1),
        numberField<NumberKind::uint32>(14, "transmission_mode", &Self::_transmissionMode, 10));
  }

 private:
  friend class Message<KCellularLteCdrxConfig>;

  std::uint64_t _timestamp = 0;
  std::uint32_t _cellStatus = 0;
  std::uint32_t _onDurationMs = 0;
  std::uint32_t _drxInactivityMs = 0;
  std::uint32_t _drxRetxTimerMs = 0;
  std::uint32_t _longDrxCycleMs = 0;
  std::uint32_t _shortDrxCycleMs = 0;
  std::uint32_t _drxShortCycleNum = 0;
  std::int32_t _rrcState = 0;
  std::uint32_t _cdrxConfigStatus = 0;
  std::uint32_t _transmissionMode = 0;
  Presence<std::uint16_t> _has;
};

extern template class Message<KCellularLteCdrxConfig>;

}  // namespace vespscope
