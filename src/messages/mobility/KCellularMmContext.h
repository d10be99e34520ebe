// Circuit-switched mobility management context (3GPP TS 24.008).
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
#include "messages/mobility/KCellularLocationAreaId.h"
#include "messages/mobility/MmProcFailureCause.h"
#include "messages/mobility/MmRejectCause.h"

namespace vespscope {

class KCellularMmContext final : public Message<KCellularMmContext> {
 public:
  static constexpr std::string_view className = "KCellularMmContext";

  // Update status of the context.
  struct UpdateStatus {
    enum : std::int32_t {
      STATUS_UPDATED = 1,
      STATUS_NOT_UPDATED = 2,
      STATUS_ROAMING_NOT_ALLOWED = 3,
      STATUS_UPDATE_DISABLED = 4,
    };
    // What a field that is not set reads as.
    static constexpr std::int32_t firstDeclared = STATUS_UPDATED;
    static constexpr EnumerationName names[] = {
      {STATUS_UPDATED, "STATUS_UPDATED"},
      {STATUS_NOT_UPDATED, "STATUS_NOT_UPDATED"},
      {STATUS_ROAMING_NOT_ALLOWED, "STATUS_ROAMING_NOT_ALLOWED"},
      {STATUS_UPDATE_DISABLED, "STATUS_UPDATE_DISABLED"},
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
    _has.set(3);
  }
  void setHasRegStatus(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasRegStatus() const noexcept { return _has.test(3); }

  // A value of UpdateStatus, its first one when not set; numbers without a name occur.
  [[nodiscard]] std::int32_t updateStatus() const noexcept { return hasUpdateStatus() ? _updateStatus : UpdateStatus::firstDeclared; }
  void setUpdateStatus(std::int32_t updateStatus) noexcept {
    _updateStatus = updateStatus;
    _has.set(7);
  }
  void setHasUpdateStatus(bool present) noexcept { _has.set(7, present); }
  [[nodiscard]] bool hasUpdateStatus() const noexcept { return _has.test(7); }

  // Null when absent.
  [[nodiscard]] std::shared_ptr<KCellularLocationAreaId> lai() const noexcept { return _lai; }
  void setLai(std::shared_ptr<KCellularLocationAreaId> lai) noexcept { _lai = std::move(lai); }
  [[nodiscard]] bool hasLai() const noexcept { return _lai != nullptr; }

  [[nodiscard]] std::uint32_t tmsi() const noexcept { return _tmsi; }
  void setTmsi(std::uint32_t tmsi) noexcept {
    _tmsi = tmsi;
    _has.set(6);
  }
  void setHasTmsi(bool present) noexcept { _has.set(6, present); }
  [[nodiscard]] bool hasTmsi() const noexcept { return _has.test(6); }

  [[nodiscard]] std::uint32_t t3212DurS() const noexcept { return _t3212DurS; }
  void setT3212DurS(std::uint32_t t3212DurS) noexcept {
    _t3212DurS = t3212DurS;
    _has.set(5);
  }
  void setHasT3212DurS(bool present) noexcept { _has.set(5, present); }
  [[nodiscard]] bool hasT3212DurS() const noexcept { return _has.test(5); }

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
    _has.set(4);
  }
  void setHasRejectCause(bool present) noexcept { _has.set(4, present); }
  [[nodiscard]] bool hasRejectCause() const noexcept { return _has.test(4); }

  [[nodiscard]] bool isCombinedProc() const noexcept { return _isCombinedProc; }
  void setIsCombinedProc(bool isCombinedProc) noexcept {
    _isCombinedProc = isCombinedProc;
    _has.set(1);
  }
  void setHasIsCombinedProc(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasIsCombinedProc() const noexcept { return _has.test(1); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        enumerationField(2, "reg_status", &Self::_regStatus, 3, RegStatus::names),
        enumerationField(3, "update_status", &Self::_updateStatus, 7, UpdateStatus::names),
        messageField(4, "lai", &Self::_lai),
        numberField<NumberKind::uint32>(5, "tmsi", &Self::_tmsi, 6),
        numberField<NumberKind::uint32>(6, "t3212_dur_s", &Self::_t3212DurS, 5),
        enumerationField(7, "proc_failure_cause", &Self::_procFailureCause, 2, MmProcFailureCause::names),
        enumerationField(8, "reject_cause", &Self::_rejectCause, 4, MmRejectCause::names),
        numberField<NumberKind::boolean>(9, "is_combined_proc", &Self::_isCombinedProc, 1));
  }

 private:
  friend class Message<KCellularMmContext>;

  std::uint64_t _timestamp = 0;
  std::shared_ptr<KCellularLocationAreaId> _lai;
  std::int32_t _regStatus = 0;
  std::int32_t _updateStatus = 0;
  std::uint32_t _tmsi = 0;
  std::uint32_t _t3212DurS = 0;
  std::int32_t _procFailureCause = 0;
  std::int32_t _rejectCause = 0;
  bool _isCombinedProc = false;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularMmContext>;

}  // namespace vespscope
