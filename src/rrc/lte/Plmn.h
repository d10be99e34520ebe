// A mobile network's identity.
#pragma once

#include <cstdint>
#include <optional>

#include "rrc/Message.h"

namespace vespscope::rrc::lte {

struct Plmn {
  std::uint16_t countryCode = 0;   // 0..999
  std::uint16_t networkCode = 0;   // 0..999
  std::uint8_t networkDigits = 0;  // 2 or 3
  bool operator==(const Plmn&) const = default;
};

// PLMN-Identity. Where a list leaves out a country, it is the one of the entry before; without one there, nothing.
[[nodiscard]] std::optional<Plmn> plmnOf(const View& identity, const std::optional<Plmn>& before = std::nullopt);

}  // namespace vespscope::rrc::lte
