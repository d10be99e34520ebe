// Radio configuration of the UMTS RRC connection.
//
// Written by messagegen from schema/umts.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <string_view>
#include <tuple>

#include "messages/Message.h"

namespace vespscope {

class KCellularWcdmaRrcConfiguration final : public Message<KCellularWcdmaRrcConfiguration> {
 public:
  static constexpr std::string_view className = "KCellularWcdmaRrcConfiguration";

  [[nodiscard]] std::uint64_t timestamp() const noexcept { return _timestamp; }
  void setTimestamp(std::uint64_t timestamp) noexcept {
    _timestamp = timestamp;
    _has.set(0);
  }
  void setHasTimestamp(bool present) noexcept { _has.set(0, present); }
  [[nodiscard]] bool hasTimestamp() const noexcept { return _has.test(0); }

  [[nodiscard]] std::uint32_t drxCycleLengthMs() const noexcept { return _drxCycleLengthMs; }
  void setDrxCycleLengthMs(std::uint32_t drxCycleLengthMs) noexcept {
    _drxCycleLengthMs = drxCycleLengthMs;
    _has.set(1);
  }
  void setHasDrxCycleLengthMs(bool present) noexcept { _has.set(1, present); }
  [[nodiscard]] bool hasDrxCycleLengthMs() const noexcept { return _has.test(1); }

  [[nodiscard]] bool isMimoConfigured() const noexcept { return _isMimoConfigured; }
  void setIsMimoConfigured(bool isMimoConfigured) noexcept {
    _isMimoConfigured = isMimoConfigured;
    _has.set(3);
  }
  void setHasIsMimoConfigured(bool present) noexcept { _has.set(3, present); }
  [[nodiscard]] bool hasIsMimoConfigured() const noexcept { return _has.test(3); }

  [[nodiscard]] bool isDcConfigured() const noexcept { return _isDcConfigured; }
  void setIsDcConfigured(bool isDcConfigured) noexcept {
    _isDcConfigured = isDcConfigured;
    _has.set(2);
  }
  void setHasIsDcConfigured(bool present) noexcept { _has.set(2, present); }
  [[nodiscard]] bool hasIsDcConfigured() const noexcept { return _has.test(2); }

  // The fields in tag order; only the message's operations need it.
  template <class Self>
  static constexpr auto fieldTable() {
    return std::tuple(
        numberField<NumberKind::uint64>(1, "timestamp", &Self::_timestamp, 0),
        numberField<NumberKind::uint32>(2, "drx_cycle_length_ms", &Self::_drxCycleLengthMs, 1),
        numberField<NumberKind::boolean>(3, "is_mimo_configured", &Self::_isMimoConfigured, 3),
        numberField<NumberKind::boolean>(4, "is_dc_configured", &Self::_isDcConfigured, 2));
  }

 private:
  friend class Message<KCellularWcdmaRrcConfiguration>;

  std::uint64_t _timestamp = 0;
  std::uint32_t _drxCycleLengthMs = 0;
  bool _isMimoConfigured = false;
  bool _isDcConfigured = false;
  Presence<std::uint8_t> _has;
};

extern template class Message<KCellularWcdmaRrcConfiguration>;

}  // namespace vespscope
