// EPS mobility management context (3GPP TS 24.301).
//
// Written by messagegen from schema/lte.proto; change it there.
// clang-format off
#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>
#include <string_view>
#include <tuple>
#include <utility>

#include "messages/Message.h"
#include "messages/common/RegStatus.h"
#include "messages/lte/Guti.h"
#include "messages/lte/KCellularTrackingAreaId.h"

namespace vespscope {

class KCellularEmmContext final : public Message<KCellularEmmContext> {
 public:
  static constexpr std::string_view className = "KCellularEmmContext";

  // Update status of the context.
  struct UpdateStatus {
    enum : std::int32_t {
      EPS_STATUS_UPDATED = 0,
      EPS_STATUS_NOT_UPDATED = 1,
      EPS_STATUS_ROAMING_NOT_ALLOWED = 2,
    };
    // What a field that is not set reads as.
    static constexpr std::int32_t firstDeclared = EPS_STATUS_UPDATED;
    static constexpr EnumerationName names[] = {
      {EPS_STATUS_UPDATED, "EPS_STATUS_UPDATED"},
      {EPS_STATUS_NOT_UPDATED, "EPS_STATUS_NOT_UPDATED"},
      {EPS_STATUS_ROAMING_NOT_ALLOWED, "EPS_STATUS_ROAMING_NOT_ALLOWED"},
    };
    // The name of `number`, if it has one.
    [[nodiscard]] static std::optional<std::string_view> nameOf(std::int32_t number) { return enumerationName(names, number); }
  };

  // EPS mode of operation of the phone (3GPP TS 24.301 4.3).
  struct UeOpMode {
    enum : std::int32_t {
      EPS_UE_OP_MODE_PS_MODE_1 = 0,
      EPS_UE_OP_MODE_PS_MODE_2 = 1,
      EPS_UE_OP_MODE_CSPS_MODE_1 = 2,
      EPS_UE_OP_MODE_CSPS_MODE_2 = 3,
    };
    // What a field that is not set reads as.
    static constexpr std::int32_t firstDeclared = EPS_UE_OP_MODE_PS_MODE_1;
    static constexpr EnumerationName names[] = {
      {EPS_UE_OP_MODE_PS_MODE_1, "EPS_UE_OP_MODE_PS_MODE_1"},
      {EPS_UE_OP_MODE_PS_MODE_2, "EPS_UE_OP_MODE_PS_MODE_2"},
      {EPS_UE_OP_MODE_CSPS_MODE_1, "EPS_UE_OP_MODE_CSPS_MODE_1"},
      {EPS_UE_OP_MODE_CSPS_MODE_2, "EPS_UE_OP_MODE_CSPS_MODE_2"},
    };
    // The name of `number`, if it has one.
    [[nodiscard]] static std::optional<std::string_view> nameOf(std::int32_t number) { return enumerationName(names, number); }
  };

  // EMM reject cause of the network (3GPP TS 24.301 9.9.3.9); numbers between the named ones have no name.
  struct RejectCause {
    enum : std::int32_t {
      EMM_CAUSE_NO_CAUSE = 0,
      EMM_CAUSE_IMSI_UNKNOWN_IN_HSS = 2,
      EMM_CAUSE_ILLEGAL_UE = 3,
      EMM_CAUSE_IMEI_NOT_ACCEPTED = 5,
      EMM_CAUSE_ILLEGAL_ME = 6,
      EMM_CAUSE_EPS_SERVICES_NOT_ALLOWED = 7,
      EMM_CAUSE_EPS_SERVICES_AND_NON_EPS_SERVICES_NOT_ALLOWED = 8,
      EMM_CAUSE_UE_IDENTITY_CANNOT_BE_DERIVED_BY_NETWORK = 9,
      EMM_CAUSE_IMPLICITLY_DETACHED = 10,
      EMM_CAUSE_PLMN_NOT_ALLOWED = 11,
      EMM_CAUSE_TRACKING_AREA_NOT_ALLOWED = 12,
      EMM_CAUSE_ROAMING_NOT_ALLOWED_IN_THIS_TRACKING_AREA = 13,
      EMM_CAUSE_EPS_SERVICES_NOT_ALLOWED_IN_THIS_PLMN = 14,
      EMM_CAUSE_NO_SUITABLE_CELLS_IN_TRACKING_AREA = 15,
      EMM_CAUSE_MSC_TEMPORARILY_NOT_REACHABLE = 16,
      EMM_CAUSE_NETWORK_FAILURE = 17,
      EMM_CAUSE_CS_DOMAIN_NOT_AVAILABLE = 18,
      EMM_CAUSE_ESM_FAILURE = 19,
      EMM_CAUSE_MAC_FAILURE = 20,
      EMM_CAUSE_SYNCH_FAILURE = 21,
      EMM_CAUSE_CONGESTION = 22,
      EMM_CAUSE_UE_SECURITY_CAPABILITY_MISMATCH = 23,
      EMM_CAUSE_SECURITY_MODE_REJECTED_UNSPECIFIED = 24,
      EMM_CAUSE_NOT_AUTHORIZED_FOR_THIS_CSG = 25,
      EMM_CAUSE_NON_EPS_AUTHENTICATION_UNACCEPTABLE = 26,
      EMM_CAUSE_REQUESTED_SERVICE_OPTION_NOT_AUTHORIZED_IN_THIS_PLMN = 35,
      EMM_CAUSE_CS_DOMAIN_TEMPORARILY_NOT_AVAILABLE = 39,
      EMM_CAUSE_NO_EPS_BEARER_CONTEXT_ACTIVATED = 40,
      EMM_CAUSE_SEMANTICALLY_INCORRECT_MESSAGE = 95,
      EMM_CAUSE_INVALID_MANDATORY_INFORMATION = 96,
      EMM_CAUSE_MESSAGE_TYPE_NON_EXISTENT_OR_NOT_IMPLEMENTED = 97,
      EMM_CAUSE_MESSAGE_TYPE_NOT_COMPATIBLE_WITH_PROTOCOL_STATE = 98,
      EMM_CAUSE_IE_NON_EXISTENT_OR_NOT_IMPLEMENTED = 99,
      EMM_CAUSE_CONDITIONAL_IE_ERROR = 100,
      EMM_CAUSE_MESSAGE_NOT_COMPATIBLE_WITH_PROTOCOL_STATE = 101,
      EMM_CAUSE_PROTOCOL_ERROR_UNSPECIFIED = 111,
    };
    // What a field that is not set reads as.
    static constexpr std::int32_t firstDeclared = EMM_CAUSE_NO_CAUSE;
    static constexpr EnumerationName names[] = {
      {EMM_CAUSE_NO_CAUSE, "EMM_CAUSE_NO_CAUSE"},
      {EMM_CAUSE_IMSI_UNKNOWN_IN_HSS, "EMM_CAUSE_IMSI_UNKNOWN_IN_HSS"},
      {EMM_CAUSE_ILLEGAL_UE, "EMM_CAUSE_ILLEGAL_UE"},
      {EMM_CAUSE_IMEI_NOT_ACCEPTED, "EMM_CAUSE_IMEI_NOT_ACCEPTED"},
      {EMM_CAUSE_ILLEGAL_ME, "EMM_CAUSE_ILLEGAL_ME"},
      {EMM_CAUSE_EPS_SERVICES_NOT_ALLOWED, "EMM_CAUSE_EPS_SERVICES_NOT_ALLOWED"},
      {EMM_CAUSE_EPS_SERVICES_AND_NON_EPS_SERVICES_NOT_ALLOWED, "EMM_CAUSE_EPS_SERVICES_AND_NON_EPS_SERVICES_NOT_ALLOWED"},
      {EMM_CAUSE_UE_IDENTITY_CANNOT_BE_DERIVED_BY_NETWORK, "EMM_CAUSE_UE_IDENTITY_CANNOT_BE_DERIVED_BY_NETWORK"},
      {EMM_CAUSE_IMPLICITLY_DETACHED, "EMM_CAUSE_IMPLICITLY_DETACHED"},
      {EMM_CAUSE_PLMN_NOT_ALLOWED, "EMM_CAUSE_PLMN_NOT_ALLOWED"},
      {EMM_CAUSE_TRACKING_AREA_NOT_ALLOWED, "EMM_CAUSE_TRACKING_AREA_NOT_ALLOWED"},
      {EMM_CAUSE_ROAMING_NOT_ALLOWED_IN_THIS_TRACKING_AREA, "EMM_CAUSE_ROAMING_NOT_ALLOWED_IN_THIS_TRACKING_AREA"},
      {EMM_CAUSE_EPS_SERVICES_NOT_ALLOWED_IN_THIS_PLMN, "EMM_CAUSE_EPS_SERVICES_NOT_ALLOWED_IN_THIS_PLMN"},
      {EMM_CAUSE_NO_SUITABLE_CELLS_IN_TRACKING_AREA, "EMM_CAUSE_NO_SUITABLE_CELLS_IN_TRACKING_AREA"},
      {EMM_CAUSE_MSC_TEMPORARILY_NOT_REACHABLE, "EMM_CAUSE_MSC_TEMPORARILY_NOT_REACHABLE"},
      {EMM_CAUSE_NETWORK_FAILURE, "EMM_CAUSE_NETWORK_FAILURE"},
      {EMM_CAUSE_CS_DOMAIN_NOT_AVAILABLE, "EMM_CAUSE_CS_DOMAIN_NOT_AVAILABLE"},
      {EMM_CAUSE_ESM_FAILURE, "EMM_CAUSE_ESM_FAILURE"},
      {EMM_CAUSE_MAC_FAILURE, "EMM_CAUSE_MAC_FAILURE"},
      {EMM_CAUSE_SYNCH_FAILURE, "EMM_CAUSE_SYNCH_FAILURE"},
      {EMM_CAUSE_CONGESTION, "EMM_CAUSE_CONGESTION"},
      {EMM_CAUSE_UE_SECURITY_CAPABILITY_MISMATCH, "EMM_CAUSE_UE_SECURITY_CAPABILITY_MISMATCH"},
      {EMM_CAUSE_SECURITY_MODE_REJECTED_UNSPECIFIED, "EMM_CAUSE_SECURITY_MODE_REJECTED_UNSPECIFIED"},
      {EMM_CAUSE_NOT_AUTHORIZED_FOR_THIS_CSG, "EMM_CAUSE_NOT_AUTHORIZED_FOR_THIS_CSG"},
      {EMM_CAUSE_NON_EPS_AUTHENTICATION_UNACCEPTABLE, "EMM_CAUSE_NON_EPS_AUTHENTICATION_UNACCEPTABLE"},
      {EMM_CAUSE_REQUESTED_SERVICE_OPTION_NOT_AUTHORIZED_IN_THIS_PLMN, "EMM_CAUSE_REQUESTED_SERVICE_OPTION_NOT_AUTHORIZED_IN_THIS_PLMN"},
      {EMM_CAUSE_CS_DOMAIN_TEMPORARILY_NOT_AVAILABLE, "EMM_CAUSE_CS_DOMAIN_TEMPORARILY_NOT_AVAILABLE"},
      {EMM_CAUSE_NO_EPS_BEARER_CONTEXT_ACTIVATED, "EMM_CAUSE_NO_EPS_BEARER_CONTEXT_ACTIVATED"},
      {EMM_CAUSE_SEMANTICALLY_INCORRECT_MESSAGE, "EMM_CAUSE_SEMANTICALLY_INCORRECT_MESSAGE"},
      {EMM_CAUSE_INVALID_MANDATORY_INFORMATION, "EMM_CAUSE_INVALID_MANDATORY_INFORMATION"},
      {EMM_CAUSE_MESSAGE_TYPE_NON_EXISTENT_OR_NOT_IMPLEMENTED, "EMM_CAUSE_MESSAGE_TYPE_NON_EXISTENT_OR_NOT_IMPLEMENTED"},
      {EMM_CAUSE_MESSAGE_TYPE_NOT_COMPATIBLE_WITH_PROTOCOL_STATE, "EMM_CAUSE_MESSAGE_TYPE_NOT_COMPATIBLE_WITH_PROTOCOL_STATE"},
      {EMM_CAUSE_IE_NON_EXISTENT_OR_NOT_IMPLEMENTED, "EMM_CAUSE_IE_NON_EXISTENT_OR_NOT_IMPLEMENTED"},
      {EMM_CAUSE_CONDITIONAL_IE_ERROR, "EMM_CAUSE_CONDITIONAL_IE_ERROR"},
      {EMM_CAUSE_MESSAGE_NOT_COMPATIBLE_WITH_PROTOCOL_STATE, "EMM_CAUSE_MESSAGE_NOT_COMPATIBLE_WITH_PROTOCOL_STATE"},
      {EMM_CAUSE_PROTOCOL_ERROR_UNSPECIFIED, "EMM_CAUSE_PROTOCOL_ERROR_UNSPECIFIED"},
    };
    // The name of `number`, if it has one.
    [[nodiscard]] static std::optional<std::string_view> nameOf(std::int32_t number) { return enumerationName(names, number); }
  };

  // Registration procedure under way.
  struct RegProc {
    enum : std::int32_t {
      EMM_PROC_NO_PROC = 0,
      EMM_PROC_ATTACH = 1,
      EMM_PROC_ATTACH_COMB = 2,
      EMM_PROC_EMERGENCY_ATTACH = 3,
      EMM_PROC_TAU = 4,
      EMM_PROC_TAU_COMB = 5,
      EMM_PROC_PERIODIC_TAU = 6,
      EMM_PROC_SERV_REQ = 7,
    };
    // What a field that is not set reads as.
    static constexpr std::int32_t firstDeclared = EMM_PROC_NO_PROC;
    static constexpr EnumerationName names[] = {
      {EMM_PROC_NO_PROC, "EMM_PROC_NO_PROC"},
      {EMM_PROC_ATTACH, "EMM_PROC_ATTACH"},
      {EMM_PROC_ATTACH_COMB, "EMM_PROC_ATTACH_COMB"},
      {EMM_PROC_EMERGENCY_ATTACH, "EMM_PROC_EMERGENCY_ATTACH"},
      {EMM_PROC_TAU, "EMM_PROC_TAU"},
      {EMM_PROC_TAU_COMB, "EMM_PROC_TAU_COMB"},
      {EMM_PROC_PERIODIC_TAU, "EMM_PROC_PERIODIC_TAU"},
      {EMM_PROC_SERV_REQ, "EMM_PROC_SERV_REQ"},
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

  // A value of RegStatus, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t regStatus() const noexcept { return hasRegStatus() ? _regStatus : RegStatus::firstDeclared; }
  void setRegStatus(std::int32_t regStatus) noexcept {
    _regStatus = regStatus;
    _has.set(4);
  }
  void setHasRegStatus(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasRegStatus() const noexcept { return _has.test(4); }

  // A value of UpdateStatus, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t updateStatus() const noexcept { return hasUpdateStatus() ? _updateStatus : UpdateStatus::firstDeclared; }
  void setUpdateStatus(std::int32_t updateStatus) noexcept {
    _updateStatus = updateStatus;
    _has.set(8);
  }
  void setHasUpdateStatus(bool present) noexcept { _has.set(8, present); }
  [[nodiscard]] bool hasUpdateStatus() const noexcept { return _has.test(8); }

  // A value of UeOpMode, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t ueOpMode() const noexcept { return hasUeOpMode() ? _ueOpMode : UeOpMode::firstDeclared; }
  void setUeOpMode(std::int32_t ueOpMode) noexcept {
    _ueOpMode = ueOpMode;
    _has.set(7);
  }
  void setHasUeOpMode(bool present) noexcept { _has.set(7, present); }
  [[nodiscard]] bool hasUeOpMode() const noexcept { return _has.test(7); }

  void clearTaiLists() noexcept { _taiLists.clear(); }
  void addTaiList(std::shared_ptr<KCellularTrackingAreaId> taiList) { _taiLists.add(std::move(taiList)); }
  [[nodiscard]] std::size_t taiListsCount() const noexcept { return _taiLists.size(); }
  [[nodiscard]] const std::shared_ptr<KCellularTrackingAreaId>& taiListAtIndex(std::size_t index) const { return _taiLists.at(index); }

  // Null when absent.
  [[nodiscard]] std::shared_ptr<Guti> guti() const noexcept { return _guti; }
  void setGuti(std::shared_ptr<Guti> guti) noexcept { _guti = std::move(guti); }
  [[nodiscard]] bool hasGuti() const noexcept { return _guti != nullptr; }

  // A value of RejectCause, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t rejectCause() const noexcept { return hasRejectCause() ? _rejectCause : RejectCause::firstDeclared; }
  void setRejectCause(std::int32_t rejectCause) noexcept {
    _rejectCause = rejectCause;
    _has.set(5);
  }
  void setHasRejectCause(bool present) noexcept { _has.set(5, present); }
  [[nodiscard]] bool hasRejectCause() const noexcept { return _has.test(5); }

  // A value of RegProc, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t regProc() const noexcept { return hasRegProc() ? _regProc : RegProc::firstDeclared; }
  void setRegProc(std::int32_t regProc) noexcept {
    _regProc = regProc;
    _has.set(3);
  }
  void setHasRegProc(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasRegProc() const noexcept { return _has.test(3); }

  [[nodiscard]] std::uint32_t t3412DurS() const noexcept { return _t3412DurS; }
  void setT3412DurS(std::uint32_t t3412DurS) noexcept {
    _t3412DurS = t3412DurS;
    _has.set(6);
  }
  void setHasT3412DurS(bool present) noexcept { _has.set(6, present); }
  [[nodiscard]] bool hasT3412DurS() const noexcept { return _has.test(6); }

  [[nodiscard]] bool isImsVoiceSupported() const noexcept { return _isImsVoiceSupported; }
  void setIsImsVoiceSupported(bool isImsVoiceSupported) noexcept {
    _isImsVoiceSupported = isImsVoiceSupported;
    _has.set(2);
  }
  void setHasIsImsVoiceSupported(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasIsImsVoiceSupported() const noexcept { return _has.test(2); }

  [[nodiscard]] bool isEmergBearerSupported() const noexcept { return _isEmergBearerSupported; }
  void setIsEmergBearerSupported(bool isEmergBearerSupported) noexcept {
    _isEmergBearerSupported = isEmergBearerSupported;
    _has.set(1);
  }
  void setHasIsEmergBearerSupported(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasIsEmergBearerSupported() const noexcept { return _has.test(1); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        enumerationField(2, "reg_status", &Self::_regStatus, 4, RegStatus::names),
        enumerationField(3, "update_status", &Self::_updateStatus, 8, UpdateStatus::names),
        enumerationField(4, "ue_op_mode", &Self::_ueOpMode, 7, UeOpMode::names),
        messageListField(5, "tai_list", &Self::_taiLists),
        messageField(6, "guti", &Self::_guti),
        enumerationField(7, "reject_cause", &Self::_rejectCause, 5, RejectCause::names),
        enumerationField(8, "reg_proc", &Self::_regProc, 3, RegProc::names),
        numberField<NumberKind::uint32>(9, "t3412_dur_s", &Self::_t3412DurS, 6),
        numberField<NumberKind::boolean>(10, "is_ims_voice_supported", &Self::_isImsVoiceSupported, 2),
        numberField<NumberKind::boolean>(11, "is_emerg_bearer_supported", &Self::_isEmergBearerSupported, 1));
  }

 private:
  friend class Message<KCellularEmmContext>;

  std::uint64_t _timestamp = 0;
  MessageList<KCellularTrackingAreaId> _taiLists;
  std::shared_ptr<Guti> _guti;
  std::int32_t _regStatus = 0;
  std::int32_t _updateStatus = 0;
  std::int32_t _ueOpMode = 0;
  std::int32_t _rejectCause = 0;
  std::int32_t _regProc = 0;
  std::uint32_t _t3412DurS = 0;
  bool _isImsVoiceSupported = false;
  bool _isEmergBearerSupported = false;
  Presence<std::uint16_t> _has;
};

extern template class Message<KCellularEmmContext>;

}  // namespace vespscope
