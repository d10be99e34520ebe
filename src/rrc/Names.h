// The names of fields, alternatives and enumerated values, as the definitions spell them.
#pragma once

#include <cstddef>
#include <cstdint>
#include <iterator>
#include <optional>
#include <string_view>

#include "rrc/Grammar.h"

namespace vespscope::rrc {

namespace tables {

// In alphabetical order, with nothing between them.
inline constexpr char names[] =
#include "rrc/tables/Names.inc"
    ;
inline constexpr std::uint32_t nameOffsets[] = {
#include "rrc/tables/NameOffsets.inc"
};

}  // namespace tables

inline constexpr std::size_t nameCount = std::size(tables::nameOffsets) - 1;

// `id` is below nameCount; noName gives "".
constexpr std::string_view nameOf(NameId id) {
  return {tables::names + tables::nameOffsets[id], tables::nameOffsets[id + 1] - tables::nameOffsets[id]};
}

// Nothing when no message has the name.
constexpr std::optional<NameId> findName(std::string_view name) {
  std::size_t from = 0;
  for (std::size_t count = nameCount; count > 0;) {
    const std::size_t half = count / 2;
    if (nameOf(static_cast<NameId>(from + half)) < name) {
      from += half + 1;
      count -= half + 1;
    } else {
      count = half;
    }
  }
  if (from == nameCount || nameOf(static_cast<NameId>(from)) != name) return std::nullopt;
  return static_cast<NameId>(from);
}

// "rrcConnectionRelease"_name, for comparisons; the compiler refuses a name that no message has.
consteval NameId operator""_name(const char* text, std::size_t size) { return findName({text, size}).value(); }

}  // namespace vespscope::rrc
