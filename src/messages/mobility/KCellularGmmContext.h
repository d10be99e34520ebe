// Packet-switched mobility management context (3GPP TS 24.008).
//
// Written by messagegen from schema/mobility.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string_view>
#include <tuple>
#include <utility>

#include "messages/Message.h"
#include "messages/common/RegStatus.h"
#include "messages/mobility/MmProcFailureCause.h"
#include "messages/mobility/MmRejectCause.h"
#include "messages/mobility/RoutingAreaId.h"

namespace vespscope {

class KCellularGmmContext final : public Message<KCellularGmmContext> {
 public:
  static constexpr std::string_view className = "KCellularGmmContext";

  // Update status of the context.
  struct UpdateStatus {
    enum : std::int32_t {
      GPRS_STATUS_UPDATED = 0,
      GPRS_STATUS_NOT_UPDATED = 1,
      GPRS_STATUS_ROAMING_NOT_ALLOWED = 2,
    };
    // What a field that is not set reads as.
    static constexpr std::int32_t firstDeclared = GPRS_STATUS_UPDATED;
    static constexpr EnumerationName names[] = {
      {GPRS_STATUS_UPDATED, "GPRS_STATUS_UPDATED"},
      {GPRS_STATUS_NOT_UPDATED, "GPRS_STATUS_NOT_UPDATED"},
      {GPRS_STATUS_ROAMING_NOT_ALLOWED, "GPRS_STATUS_ROAMING_NOT_ALLOWED"},
    };
    // The name of `number`, if it has one.
    [[nodiscard]] static std::optional<std::string_view> nameOf(std::int32_t number) { return enumerationName(names, number); }
  };

  // Registration procedure under way.
  struct RegProc {
    enum : std::int32_t {
      KNAS_MM_REG_PROC_LOCATION_AREA_UPDATE = 0,
      KNAS_MM_REG_PROC_ATTACH = 1,
      KNAS_MM_REG_PROC_ROUTING_AREA_UPDATE = 2,
      KNAS_MM_REG_PROC_COMBINED_RAU = 3,
      KNAS_MM_REG_PROC_COMBINED_ATTACH = 4,
      KNAS_MM_REG_PROC_NW_DETACH = 5,
      KNAS_MM_REG_PROC_SERVICE_REQ = 6,
      KNAS_MM_REG_PROC_NW_ABORT = 7,
      KNAS_MM_REG_PROC_TRACKING_AREA_UPDATE = 8,
      KNAS_MM_REG_PROC_COMBINED_TAU = 9,
      KNAS_MM_REG_PROC_PROC_NONE = 10,
    };
    // What a field that is not set reads as.
    static constexpr std::int32_t firstDeclared = KNAS_MM_REG_PROC_LOCATION_AREA_UPDATE;
    static constexpr EnumerationName names[] = {
      {KNAS_MM_REG_PROC_LOCATION_AREA_UPDATE, "KNAS_MM_REG_PROC_LOCATION_AREA_UPDATE"},
      {KNAS_MM_REG_PROC_ATTACH, "KNAS_MM_REG_PROC_ATTACH"},
      {KNAS_MM_REG_PROC_ROUTING_AREA_UPDATE, "KNAS_MM_REG_PROC_ROUTING_AREA_UPDATE"},
      {KNAS_MM_REG_PROC_COMBINED_RAU, "KNAS_MM_REG_PROC_COMBINED_RAU"},
      {KNAS_MM_REG_PROC_COMBINED_ATTACH, "KNAS_MM_REG_PROC_COMBINED_ATTACH"},
      {KNAS_MM_REG_PROC_NW_DETACH, "KNAS_MM_REG_PROC_NW_DETACH"},
      {KNAS_MM_REG_PROC_SERVICE_REQ, "KNAS_MM_REG_PROC_SERVICE_REQ"},
      {KNAS_MM_REG_PROC_NW_ABORT, "KNAS_MM_REG_PROC_NW_ABORT"},
      {KNAS_MM_REG_PROC_TRACKING_AREA_UPDATE, "KNAS_MM_REG_PROC_TRACKING_AREA_UPDATE"},
      {KNAS_MM_REG_PROC_COMBINED_TAU, "KNAS_MM_REG_PROC_COMBINED_TAU"},
      {KNAS_MM_REG_PROC_PROC_NONE, "KNAS_MM_REG_PROC_PROC_NONE"},
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
    _has.set(7);
  }
  void setHasUpdateStatus(bool present) noexcept { _has.set(7, present); }
  [[nodiscard]] bool hasUpdateStatus() const noexcept { return _has.test(7); }

  // Null when absent.
  [[nodiscard]] std::shared_ptr<RoutingAreaId> rai() const noexcept { return _rai; }
  void setRai(std::shared_ptr<RoutingAreaId> rai) noexcept { _rai = std::move(rai); }
  [[nodiscard]] bool hasRai() const noexcept { return _rai != nullptr; }

  [[nodiscard]] std::uint32_t pTmsi() const noexcept { return _pTmsi; }
  void setPTmsi(std::uint32_t pTmsi) noexcept {
    _pTmsi = pTmsi;
    _has.set(1);
  }
  void setHasPTmsi(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasPTmsi() const noexcept { return _has.test(1); }

  [[nodiscard]] std::uint32_t t3312DurS() const noexcept { return _t3312DurS; }
  void setT3312DurS(std::uint32_t t3312DurS) noexcept {
    _t3312DurS = t3312DurS;
    _has.set(6);
  }
  void setHasT3312DurS(bool present) noexcept { _has.set(6, present); }
  [[nodiscard]] bool hasT3312DurS() const noexcept { return _has.test(6); }

  // A value of MmProcFailureCause, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t procFailureCause() const noexcept { return hasProcFailureCause() ? _procFailureCause : MmProcFailureCause::firstDeclared; }
  void setProcFailureCause(std::int32_t procFailureCause) noexcept {
    _procFailureCause = procFailureCause;
    _has.set(2);
  }
  void setHasProcFailureCause(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasProcFailureCause() const noexcept { return _has.test(2); }

  // A value of MmRejectCause, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t rejectCause() const noexcept { return hasRejectCause() ? _rejectCause : MmRejectCause::firstDeclared; }
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

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        enumerationField(2, "reg_status", &Self::_regStatus, 4, RegStatus::names),
        enumerationField(3, "update_status", &Self::_updateStatus, 7, UpdateStatus::names),
        messageField(4, "rai", &Self::_rai),
        numberField<NumberKind::uint32>(5, "p_tmsi", &Self::_pTmsi, 1),
        numberField<NumberKind::uint32>(6, "t3312_dur_s", &Self::_t3312DurS, 6),
        enumerationField(7, "proc_failure_cause", &Self::_procFailureCause, 2, MmProcFailureCause::names),
        enumerationField(8, "reject_cause", &Self::_rejectCause, 5, MmRejectCause::names),
        enumerationField(9, "reg_proc", &Self::_regProc, 3, RegProc::names));
  }

 private:
  friend class Message<KCellularGmmContext>;

  std::uint64_t _timestamp = 0;
  std::shared_ptr<RoutingAreaId> _rai;
  std::int32_t _regStatus = 0;
  std::int32_t _updateStatus = 0;
  std::uint32_t _pTmsi = 0;
  std::uint32_t _t3312DurS = 0;
  std::int32_t _procFailureCause = 0;
  std::int32_t _rejectCause = 0;
  std::int32_t _regProc = 0;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularGmmContext>;

}  // namespace vespscope
