// A change of the LTE RRC state and what caused it (3GPP TS 36.331).
//
// Written by messagegen from schema/lte.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>
#include <tuple>

#include "messages/Message.h"
#include "messages/lte/LteRrcState.h"

namespace vespscope {

class KCellularLteRrcState final : public Message<KCellularLteRrcState> {
 public:
  static constexpr std::string_view className = "KCellularLteRrcState";

  // Why the RRC state changed.
  struct Cause {
    enum : std::int32_t {
      KLTE_RRC_CAUSE_EST_EMERGENCY = 0,
      KLTE_RRC_CAUSE_EST_HIGH_PRIO_ACC = 1,
      KLTE_RRC_CAUSE_EST_MT_ACC = 2,
      KLTE_RRC_CAUSE_EST_MO_SIGNAL = 3,
      KLTE_RRC_CAUSE_EST_MO_DATA = 4,
      KLTE_RRC_CAUSE_EST_DELAY_TOL_ACC = 5,
      KLTE_RRC_CAUSE_REEST_RECFG_FAIL = 6,
      KLTE_RRC_CAUSE_REEST_HO_FAIL = 7,
      KLTE_RRC_CAUSE_REEST_OTHER_FAIL = 8,
      KLTE_RRC_CAUSE_REL_OTHER_RECFG_FAIL = 9,
      KLTE_RRC_CAUSE_REL_CONN_FAIL_IRAT_RESEL = 10,
      KLTE_RRC_CAUSE_REL_CONN_FAIL_T311_EXP = 11,
      KLTE_RRC_CAUSE_REL_CONN_FAIL_CELL_NOT_SUIT = 12,
      KLTE_RRC_CAUSE_REL_CONN_FAIL_REEST_REJ = 13,
      KLTE_RRC_CAUSE_REL_LOAD_BAL_TAU_REQD = 14,
      KLTE_RRC_CAUSE_REL_OTHER = 15,
      KLTE_RRC_CAUSE_REL_CSFB_HIGH_PRIO = 16,
      KLTE_RRC_CAUSE_REL_T310_EXP = 17,
      KLTE_RRC_CAUSE_REL_RND_ACC = 18,
      KLTE_RRC_CAUSE_REL_MAX_RLC_RETRANS = 19,
      KLTE_RRC_CAUSE_REL_SUCC_MOB_FROM_EUTRAN = 20,
      KLTE_RRC_CAUSE_EST_SUCC_MOB_TO_EUTRAN = 21,
      KLTE_RRC_CAUSE_EST_FAIL_NO_RESP_FROM_CELL = 22,
      KLTE_RRC_CAUSE_EST_FAIL_REJ = 23,
      KLTE_RRC_CAUSE_EST_FAIL_CELL_RESEL = 24,
      KLTE_RRC_CAUSE_EST_FAIL_ABORTED = 25,
      KLTE_RRC_CAUSE_EST_FAIL_CELL_BARRED = 26,
      KLTE_RRC_CAUSE_REEST_OTHER_FAIL_T310_EXP = 27,
      KLTE_RRC_CAUSE_REEST_OTHER_FAIL_RND_ACC = 28,
      KLTE_RRC_CAUSE_REEST_OTHER_FAIL_MAX_RLC_RETX = 29,
      KLTE_RRC_CAUSE_REEST_OTHER_FAIL_INTEG_CHECK = 30,
      KLTE_RRC_CAUSE_NO_SERVICE = 254,
      KLTE_RRC_CAUSE_NA = 255,
    };
    // What a field that is not set reads as.
    static constexpr std::int32_t firstDeclared = KLTE_RRC_CAUSE_EST_EMERGENCY;
    static constexpr EnumerationName names[] = {
      {KLTE_RRC_CAUSE_EST_EMERGENCY, "KLTE_RRC_CAUSE_EST_EMERGENCY"},
      {KLTE_RRC_CAUSE_EST_HIGH_PRIO_ACC, "KLTE_RRC_CAUSE_EST_HIGH_PRIO_ACC"},
      {KLTE_RRC_CAUSE_EST_MT_ACC, "KLTE_RRC_CAUSE_EST_MT_ACC"},
      {KLTE_RRC_CAUSE_EST_MO_SIGNAL, "KLTE_RRC_CAUSE_EST_MO_SIGNAL"},
      {KLTE_RRC_CAUSE_EST_MO_DATA, "KLTE_RRC_CAUSE_EST_MO_DATA"},
      {KLTE_RRC_CAUSE_EST_DELAY_TOL_ACC, "KLTE_RRC_CAUSE_EST_DELAY_TOL_ACC"},
      {KLTE_RRC_CAUSE_REEST_RECFG_FAIL, "KLTE_RRC_CAUSE_REEST_RECFG_FAIL"},
      {KLTE_RRC_CAUSE_REEST_HO_FAIL, "KLTE_RRC_CAUSE_REEST_HO_FAIL"},
      {KLTE_RRC_CAUSE_REEST_OTHER_FAIL, "KLTE_RRC_CAUSE_REEST_OTHER_FAIL"},
      {KLTE_RRC_CAUSE_REL_OTHER_RECFG_FAIL, "KLTE_RRC_CAUSE_REL_OTHER_RECFG_FAIL"},
      {KLTE_RRC_CAUSE_REL_CONN_FAIL_IRAT_RESEL, "KLTE_RRC_CAUSE_REL_CONN_FAIL_IRAT_RESEL"},
      {KLTE_RRC_CAUSE_REL_CONN_FAIL_T311_EXP, "KLTE_RRC_CAUSE_REL_CONN_FAIL_T311_EXP"},
      {KLTE_RRC_CAUSE_REL_CONN_FAIL_CELL_NOT_SUIT, "KLTE_RRC_CAUSE_REL_CONN_FAIL_CELL_NOT_SUIT"},
      {KLTE_RRC_CAUSE_REL_CONN_FAIL_REEST_REJ, "KLTE_RRC_CAUSE_REL_CONN_FAIL_REEST_REJ"},
      {KLTE_RRC_CAUSE_REL_LOAD_BAL_TAU_REQD, "KLTE_RRC_CAUSE_REL_LOAD_BAL_TAU_REQD"},
      {KLTE_RRC_CAUSE_REL_OTHER, "KLTE_RRC_CAUSE_REL_OTHER"},
      {KLTE_RRC_CAUSE_REL_CSFB_HIGH_PRIO, "KLTE_RRC_CAUSE_REL_CSFB_HIGH_PRIO"},
      {KLTE_RRC_CAUSE_REL_T310_EXP, "KLTE_RRC_CAUSE_REL_T310_EXP"},
      {KLTE_RRC_CAUSE_REL_RND_ACC, "KLTE_RRC_CAUSE_REL_RND_ACC"},
      {KLTE_RRC_CAUSE_REL_MAX_RLC_RETRANS, "KLTE_RRC_CAUSE_REL_MAX_RLC_RETRANS"},
      {KLTE_RRC_CAUSE_REL_SUCC_MOB_FROM_EUTRAN, "KLTE_RRC_CAUSE_REL_SUCC_MOB_FROM_EUTRAN"},
      {KLTE_RRC_CAUSE_EST_SUCC_MOB_TO_EUTRAN, "KLTE_RRC_CAUSE_EST_SUCC_MOB_TO_EUTRAN"},
      {KLTE_RRC_CAUSE_EST_FAIL_NO_RESP_FROM_CELL, "KLTE_RRC_CAUSE_EST_FAIL_NO_RESP_FROM_CELL"},
      {KLTE_RRC_CAUSE_EST_FAIL_REJ, "KLTE_RRC_CAUSE_EST_FAIL_REJ"},
      {KLTE_RRC_CAUSE_EST_FAIL_CELL_RESEL, "KLTE_RRC_CAUSE_EST_FAIL_CELL_RESEL"},
      {KLTE_RRC_CAUSE_EST_FAIL_ABORTED, "KLTE_RRC_CAUSE_EST_FAIL_ABORTED"},
      {KLTE_RRC_CAUSE_EST_FAIL_CELL_BARRED, "KLTE_RRC_CAUSE_EST_FAIL_CELL_BARRED"},
      {KLTE_RRC_CAUSE_REEST_OTHER_FAIL_T310_EXP, "KLTE_RRC_CAUSE_REEST_OTHER_FAIL_T310_EXP"},
      {KLTE_RRC_CAUSE_REEST_OTHER_FAIL_RND_ACC, "KLTE_RRC_CAUSE_REEST_OTHER_FAIL_RND_ACC"},
      {KLTE_RRC_CAUSE_REEST_OTHER_FAIL_MAX_RLC_RETX, "KLTE_RRC_CAUSE_REEST_OTHER_FAIL_MAX_RLC_RETX"},
      {KLTE_RRC_CAUSE_REEST_OTHER_FAIL_INTEG_CHECK, "KLTE_RRC_CAUSE_REEST_OTHER_FAIL_INTEG_CHECK"},
      {KLTE_RRC_CAUSE_NO_SERVICE, "KLTE_RRC_CAUSE_NO_SERVICE"},
      {KLTE_RRC_CAUSE_NA, "KLTE_RRC_CAUSE_NA"},
    };
    // The name of `number`, if it has one.
    [[nodiscard]] static std::optional<std::string_view> nameOf(std::int32_t number) { return enumerationName(names, number); }
  };

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  // A value of LteRrcState, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t state() const noexcept { return hasState() ? _state : LteRrcState::firstDeclared; }
  void setState(std::int32_t state) noexcept {
    _state = state;
    _has.set(4);
  }
  void setHasState(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasState() const noexcept { return _has.test(4); }

  // A value of LteRrcState, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t prevState() const noexcept { return hasPrevState() ? _prevState : LteRrcState::firstDeclared; }
  void setPrevState(std::int32_t prevState) noexcept {
    _prevState = prevState;
    _has.set(2);
  }
  void setHasPrevState(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasPrevState() const noexcept { return _has.test(2); }

  [[nodiscard]] std::uint32_t prevStateDurMs() const noexcept { return _prevStateDurMs; }
  void setPrevStateDurMs(std::uint32_t prevStateDurMs) noexcept {
    _prevStateDurMs = prevStateDurMs;
    _has.set(3);
  }
  void setHasPrevStateDurMs(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasPrevStateDurMs() const noexcept { return _has.test(3); }

  // A value of Cause, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t cause() const noexcept { return hasCause() ? _cause : Cause::firstDeclared; }
  void setCause(std::int32_t cause) noexcept {
    _cause = cause;
    _has.set(1);
  }
  void setHasCause(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasCause() const noexcept { return _has.test(1); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        enumerationField(2, "state", &Self::_state, 4, LteRrcState::names),
        enumerationField(3, "prev_state", &Self::_prevState, 2, LteRrcState::names),
        numberField<NumberKind::uint32>(4, "prev_state_dur_ms", &Self::_prevStateDurMs, 3),
        enumerationField(5, "cause", &Self::_cause, 1, Cause::names));
  }

 private:
  friend class Message<KCellularLteRrcState>;

  std::uint64_t _timestamp = 0;
  std::int32_t _state = 0;
  std::int32_t _prevState = 0;
  std::uint32_t _prevStateDurMs = 0;
  std::int32_t _cause = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularLteRrcState>;

}  // namespace vespscope
