// Names of an enumeration's values, looked up by number.
#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>

#include "values/Value.h"

namespace vespscope {

struct EnumerationName {
  std::int32_t number;
  std::string_view name;
};

// In ascending order of the numbers.
using EnumerationNames = std::span<const EnumerationName>;

// The name of `number`, if it has one.
[[nodiscard]] std::optional<std::string_view> enumerationName(EnumerationNames names, std::int32_t number);

// The name of `number`, or "(unknown: 99)" for a number without one.
[[nodiscard]] std::string enumerationText(EnumerationNames names, std::int32_t number);
// The same as a value, which keeps no copy of the name.
[[nodiscard]] Value enumerationValue(EnumerationNames names, std::int32_t number);

}  // namespace vespscope
