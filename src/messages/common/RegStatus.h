// Values of an enumeration that several messages share.
//
// Written by messagegen from schema/common.proto; change it there.
// clang-format off
#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

#include "messages/Enumeration.h"

namespace vespscope {

// Registration status, common to the EPS, circuit-switched and packet-switched contexts.
struct RegStatus {
  enum : std::int32_t {
    KREG_STATUS_NORMAL_SERVICE = 0,
    KREG_STATUS_REGISTRATION_FAILURE = 1,
    KREG_STATUS_LIMITED_SERVICE = 2,
    KREG_STATUS_NO_SERVICE = 3,
    KREG_STATUS_AT_NOT_REGISTERED = 4,
    KREG_STATUS_REGISTRATION_SERVICE_DISABLED = 5,
    KREG_STATUS_SERVICE_DETACHED = 6,
    KREG_STATUS_SERVICE_ACTIVATED = 7,
    KREG_STATUS_EMERGENCY_SERVICE = 8,
    KREG_STATUS_EMERGENCY_LIMITED = 9,
    KREG_STATUS_REGISTERED_SMS_ONLY = 10,
    KREG_STATUS_REGISTRATION_IN_PROGRESS = 11,
    KREG_STATUS_POWER_OFF_NO_SERVICE = 12,
  };
  // What a field that is not set reads as.
  static constexpr std::int32_t firstDeclared = KREG_STATUS_NORMAL_SERVICE;
  static constexpr EnumerationName names[] = {
    {KREG_STATUS_NORMAL_SERVICE, "KREG_STATUS_NORMAL_SERVICE"},
    {KREG_STATUS_REGISTRATION_FAILURE, "KREG_STATUS_REGISTRATION_FAILURE"},
    {KREG_STATUS_LIMITED_SERVICE, "KREG_STATUS_LIMITED_SERVICE"},
    {KREG_STATUS_NO_SERVICE, "KREG_STATUS_NO_SERVICE"},
    {KREG_STATUS_AT_NOT_REGISTERED, "KREG_STATUS_AT_NOT_REGISTERED"},
    {KREG_STATUS_REGISTRATION_SERVICE_DISABLED, "KREG_STATUS_REGISTRATION_SERVICE_DISABLED"},
    {KREG_STATUS_SERVICE_DETACHED, "KREG_STATUS_SERVICE_DETACHED"},
    {KREG_STATUS_SERVICE_ACTIVATED, "KREG_STATUS_SERVICE_ACTIVATED"},
    {KREG_STATUS_EMERGENCY_SERVICE, "KREG_STATUS_EMERGENCY_SERVICE"},
    {KREG_STATUS_EMERGENCY_LIMITED, "KREG_STATUS_EMERGENCY_LIMITED"},
    {KREG_STATUS_REGISTERED_SMS_ONLY, "KREG_STATUS_REGISTERED_SMS_ONLY"},
    {KREG_STATUS_REGISTRATION_IN_PROGRESS, "KREG_STATUS_REGISTRATION_IN_PROGRESS"},
    {KREG_STATUS_POWER_OFF_NO_SERVICE, "KREG_STATUS_POWER_OFF_NO_SERVICE"},
  };
  // The name of `number`, if it has one.
  [[nodiscard]] static std::optional<std::string_view> nameOf(std::int32_t number) { return enumerationName(names, number); }
};

}  // namespace vespscope
