#include "messages/Enumeration.h"

#include <algorithm>
#include <string>

namespace vespscope {

std::optional<std::string_view> enumerationName(EnumerationNames names, std::int32_t number) {
  // Most enumerations count from zero without a gap. A number below zero becomes one beyond them all.
  if (const auto guess = static_cast<std::size_t>(number); guess < names.size() && names[guess].number == number) {
    return names[guess].name;
  }
  const auto found =
      std::lower_bound(names.begin(), names.end(), number,
                       [](const EnumerationName& entry, std::int32_t wanted) { return entry.number < wanted; });
  if (found == names.end() || found->number != number) return std::nullopt;
  return found->name;
}

std::string enumerationText(EnumerationNames names, std::int32_t number) {
  if (const auto name = enumerationName(names, number)) return std::string(*name);
  return "(unknown: " + std::to_string(number) + ")";
}

Value enumerationValue(EnumerationNames names, std::int32_t number) {
  if (const auto name = enumerationName(names, number)) return Value::ofStatic(*name);
  return enumerationText(names, number);
}

}  // namespace vespscope
