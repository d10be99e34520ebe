// State of the UMTS RRC connection with the causes of its last set-up and release (3GPP TS 25.331).
//
// Written by messagegen from schema/umts.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class KCellularWcdmaRrcConnectionState final : public Message<KCellularWcdmaRrcConnectionState> {
 public:
  static constexpr std::string_view className = "KCellularWcdmaRrcConnectionState";

  // State of the connection.
  struct State {
    enum : std::int32_t {
      KWCDMA_RRC_CONN_STATE_INVALID = 0,
      KWCDMA_RRC_CONN_STATE_INACTIVE = 1,
      KWCDMA_RRC_CONN_STATE_IDLE = 2,
      KWCDMA_RRC_CONN_STATE_ESTABLISH = 3,
      KWCDMA_RRC_CONN_STATE_URA_PCH = 4,
      KWCDMA_RRC_CONN_STATE_CELL_PCH = 5,
      KWCDMA_RRC_CONN_STATE_CELL_FACH = 6,
      KWCDMA_RRC_CONN_STATE_CELL_DCH = 7,
      KWCDMA_RRC_CONN_STATE_RELEASE = 8,
      KWCDMA_RRC_CONN_STATE_RADIO_LINK_FAILURE = 9,
      KWCDMA_RRC_CONN_STATE_SCRI_SENT = 10,
    };
    // What a field that is not set reads as.
    static constexpr std::int32_t firstDeclared = KWCDMA_RRC_CONN_STATE_INVALID;
    static constexpr EnumerationName names[] = {
      {KWCDMA_RRC_CONN_STATE_INVALID, "KWCDMA_RRC_CONN_STATE_INVALID"},
      {KWCDMA_RRC_CONN_STATE_INACTIVE, "KWCDMA_RRC_CONN_STATE_INACTIVE"},
      {KWCDMA_RRC_CONN_STATE_IDLE, "KWCDMA_RRC_CONN_STATE_IDLE"},
      {KWCDMA_RRC_CONN_STATE_ESTABLISH, "KWCDMA_RRC_CONN_STATE_ESTABLISH"},
      {KWCDMA_RRC_CONN_STATE_URA_PCH, "KWCDMA_RRC_CONN_STATE_URA_PCH"},
      {KWCDMA_RRC_CONN_STATE_CELL_PCH, "KWCDMA_RRC_CONN_STATE_CELL_PCH"},
      {KWCDMA_RRC_CONN_STATE_CELL_FACH, "KWCDMA_RRC_CONN_STATE_CELL_FACH"},
      {KWCDMA_RRC_CONN_STATE_CELL_DCH, "KWCDMA_RRC_CONN_STATE_CELL_DCH"},
      {KWCDMA_RRC_CONN_STATE_RELEASE, "KWCDMA_RRC_CONN_STATE_RELEASE"},
      {KWCDMA_RRC_CONN_STATE_RADIO_LINK_FAILURE, "KWCDMA_RRC_CONN_STATE_RADIO_LINK_FAILURE"},
      {KWCDMA_RRC_CONN_STATE_SCRI_SENT, "KWCDMA_RRC_CONN_STATE_SCRI_SENT"},
    };
    // The name of `number`, if it has one.
    [[nodiscard]] static std::optional<std::string_view> nameOf(std::int32_t number) { return enumerationName(names, number); }
  };

  // Establishment cause (3GPP TS 25.331 10.3.3.11).
  struct EstablishmentCause {
    enum : std::int32_t {
      KRRC_EST_ORIG_CONV_CALL = 0,
      KRRC_EST_ORIG_STREAM_CALL = 1,
      KRRC_EST_ORIG_INTERACT_CALL = 2,
      KRRC_EST_ORIG_BACKGND_CALL = 3,
      KRRC_EST_ORIG_SUBSCRIBED_TRF_CALL = 4,
      KRRC_EST_TERM_CONV_CALL = 5,
      KRRC_EST_TERM_STREAM_CALL = 6,
      KRRC_EST_TERM_INTERACT_CALL = 7,
      KRRC_EST_TERM_BACKGND_CALL = 8,
      KRRC_EST_EMERGENCY_CALL = 9,
      KRRC_EST_INTER_RAT_CELL_RESELECT = 10,
      KRRC_EST_INTER_RAT_CELL_CHANGE_ORDER = 11,
      KRRC_EST_REGISTRATION = 12,
      KRRC_EST_DETACH = 13,
      KRRC_EST_HI_PRI_SIGNALLING = 14,
      KRRC_EST_LOW_PRI_SIGNALLING = 15,
      KRRC_EST_CALL_RE_ESTABLISH = 16,
      KRRC_EST_TERM_HI_SIGNALLING = 17,
      KRRC_EST_TERM_LOW_SIGNALLING = 18,
      KRRC_EST_TERM_UNKNOWN = 19,
      KRRC_EST_MBMS_RECEPTION = 20,
      KRRC_EST_MBMS_PTP_RB_REQUEST = 21,
      KRRC_EST_DELAY_TOLERANT_ACCESS = 22,
    };
    // What a field that is not set reads as.
    static constexpr std::int32_t firstDeclared = KRRC_EST_ORIG_CONV_CALL;
    static constexpr EnumerationName names[] = {
      {KRRC_EST_ORIG_CONV_CALL, "KRRC_EST_ORIG_CONV_CALL"},
      {KRRC_EST_ORIG_STREAM_CALL, "KRRC_EST_ORIG_STREAM_CALL"},
      {KRRC_EST_ORIG_INTERACT_CALL, "KRRC_EST_ORIG_INTERACT_CALL"},
      {KRRC_EST_ORIG_BACKGND_CALL, "KRRC_EST_ORIG_BACKGND_CALL"},
      {KRRC_EST_ORIG_SUBSCRIBED_TRF_CALL, "KRRC_EST_ORIG_SUBSCRIBED_TRF_CALL"},
      {KRRC_EST_TERM_CONV_CALL, "KRRC_EST_TERM_CONV_CALL"},
      {KRRC_EST_TERM_STREAM_CALL, "KRRC_EST_TERM_STREAM_CALL"},
      {KRRC_EST_TERM_INTERACT_CALL, "KRRC_EST_TERM_INTERACT_CALL"},
      {KRRC_EST_TERM_BACKGND_CALL, "KRRC_EST_TERM_BACKGND_CALL"},
      {KRRC_EST_EMERGENCY_CALL, "KRRC_EST_EMERGENCY_CALL"},
      {KRRC_EST_INTER_RAT_CELL_RESELECT, "KRRC_EST_INTER_RAT_CELL_RESELECT"},
      {KRRC_EST_INTER_RAT_CELL_CHANGE_ORDER, "KRRC_EST_INTER_RAT_CELL_CHANGE_ORDER"},
      {KRRC_EST_REGISTRATION, "KRRC_EST_REGISTRATION"},
      {KRRC_EST_DETACH, "KRRC_EST_DETACH"},
      {KRRC_EST_HI_PRI_SIGNALLING, "KRRC_EST_HI_PRI_SIGNALLING"},
      {KRRC_EST_LOW_PRI_SIGNALLING, "KRRC_EST_LOW_PRI_SIGNALLING"},
      {KRRC_EST_CALL_RE_ESTABLISH, "KRRC_EST_CALL_RE_ESTABLISH"},
      {KRRC_EST_TERM_HI_SIGNALLING, "KRRC_EST_TERM_HI_SIGNALLING"},
      {KRRC_EST_TERM_LOW_SIGNALLING, "KRRC_EST_TERM_LOW_SIGNALLING"},
      {KRRC_EST_TERM_UNKNOWN, "KRRC_EST_TERM_UNKNOWN"},
      {KRRC_EST_MBMS_RECEPTION, "KRRC_EST_MBMS_RECEPTION"},
      {KRRC_EST_MBMS_PTP_RB_REQUEST, "KRRC_EST_MBMS_PTP_RB_REQUEST"},
      {KRRC_EST_DELAY_TOLERANT_ACCESS, "KRRC_EST_DELAY_TOLERANT_ACCESS"},
    };
    // The name of `number`, if it has one.
    [[nodiscard]] static std::optional<std::string_view> nameOf(std::int32_t number) { return enumerationName(names, number); }
  };

  // Why the connection was released.
  struct ReleaseCause {
    enum : std::int32_t {
      KRRC_REL_OTHER_CAUSE = 0,
      KRRC_REL_NO_CAUSE = 1,
      KRRC_REL_NO_CELL = 2,
      KRRC_REL_INACTIVE = 3,
      KRRC_REL_NORMAL_EVENT = 4,
      KRRC_REL_CELL_BARRED = 5,
      KRRC_REL_CELL_CHANGED = 6,
      KRRC_REL_ACCESS_NOT_ALLOWED = 7,
      KRRC_REL_RRC_CONN_ESTABLISHMENT_FAILURE = 8,
      KRRC_REL_RELEASE_OOSA = 9,
      KRRC_REL_SIGN_CONN_REL = 10,
      KRRC_REL_CONN_REJECT_REDIRECTION = 11,
      KRRC_REL_NAS_TRIGGERED_ABORT = 12,
      KRRC_REL_CONN_REL_LOWER_LAYER_FAILURE_DL = 13,
      KRRC_REL_CONN_REL_LOWER_LAYER_FAILURE_UL = 14,
      KRRC_REL_HO_FROM_UTRAN_REVERT_BACK_SYNC_FAIL = 15,
      KRRC_REL_CONN_REJECT_CONGESTION = 16,
      KRRC_REL_CONN_REJECT_UNSPECIFIED = 17,
    };
    // What a field that is not set reads as.
    static constexpr std::int32_t firstDeclared = KRRC_REL_OTHER_CAUSE;
    static constexpr EnumerationName names[] = {
      {KRRC_REL_OTHER_CAUSE, "KRRC_REL_OTHER_CAUSE"},
      {KRRC_REL_NO_CAUSE, "KRRC_REL_NO_CAUSE"},
      {KRRC_REL_NO_CELL, "KRRC_REL_NO_CELL"},
      {KRRC_REL_INACTIVE, "KRRC_REL_INACTIVE"},
      {KRRC_REL_NORMAL_EVENT, "KRRC_REL_NORMAL_EVENT"},
      {KRRC_REL_CELL_BARRED, "KRRC_REL_CELL_BARRED"},
      {KRRC_REL_CELL_CHANGED, "KRRC_REL_CELL_CHANGED"},
      {KRRC_REL_ACCESS_NOT_ALLOWED, "KRRC_REL_ACCESS_NOT_ALLOWED"},
      {KRRC_REL_RRC_CONN_ESTABLISHMENT_FAILURE, "KRRC_REL_RRC_CONN_ESTABLISHMENT_FAILURE"},
      {KRRC_REL_RELEASE_OOSA, "KRRC_REL_RELEASE_OOSA"},
      {KRRC_REL_SIGN_CONN_REL, "KRRC_REL_SIGN_CONN_REL"},
      {KRRC_REL_CONN_REJECT_REDIRECTION, "KRRC_REL_CONN_REJECT_REDIRECTION"},
      {KRRC_REL_NAS_TRIGGERED_ABORT, "KRRC_REL_NAS_TRIGGERED_ABORT"},
      {KRRC_REL_CONN_REL_LOWER_LAYER_FAILURE_DL, "KRRC_REL_CONN_REL_LOWER_LAYER_FAILURE_DL"},
      {KRRC_REL_CONN_REL_LOWER_LAYER_FAILURE_UL, "KRRC_REL_CONN_REL_LOWER_LAYER_FAILURE_UL"},
      {KRRC_REL_HO_FROM_UTRAN_REVERT_BACK_SYNC_FAIL, "KRRC_REL_HO_FROM_UTRAN_REVERT_BACK_SYNC_FAIL"},
      {KRRC_REL_CONN_REJECT_CONGESTION, "KRRC_REL_CONN_REJECT_CONGESTION"},
      {KRRC_REL_CONN_REJECT_UNSPECIFIED, "KRRC_REL_CONN_REJECT_UNSPECIFIED"},
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

  // A value of State, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t state() const noexcept { return hasState() ? _state : State::firstDeclared; }
  void setState(std::int32_t state) noexcept {
    _state = state;
    _has.set(3);
  }
  void setHasState(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasState() const noexcept { return _has.test(3); }

  // A value of EstablishmentCause, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t establishmentCause() const noexcept { return hasEstablishmentCause() ? _establishmentCause : EstablishmentCause::firstDeclared; }
  void setEstablishmentCause(std::int32_t establishmentCause) noexcept {
    _establishmentCause = establishmentCause;
    _has.set(1);
  }
  void setHasEstablishmentCause(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasEstablishmentCause() const noexcept { return _has.test(1); }

  // A value of ReleaseCause, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t releaseCause() const noexcept { return hasReleaseCause() ? _releaseCause : ReleaseCause::firstDeclared; }
  void setReleaseCause(std::int32_t releaseCause) noexcept {
    _releaseCause = releaseCause;
    _has.set(2);
  }
  void setHasReleaseCause(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasReleaseCause() const noexcept { return _has.test(2); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        enumerationField(2, "state", &Self::_state, 3, State::names),
        enumerationField(3, "establishment_cause", &Self::_establishmentCause, 1, EstablishmentCause::names),
        enumerationField(4, "release_cause", &Self::_releaseCause, 2, ReleaseCause::names));
  }

 private:
  friend class Message<KCellularWcdmaRrcConnectionState>;

  std::uint64_t _timestamp = 0;
  std::int32_t _state = 0;
  std::int32_t _establishmentCause = 0;
  std::int32_t _releaseCause = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularWcdmaRrcConnectionState>;

}  // namespace vespscope
