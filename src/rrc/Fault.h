// Why a message cannot be read, and where.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace vespscope::rrc {

enum class FaultKind : std::uint8_t {
  truncated,      // a value reaches past the end of the message or of the extension that holds it
  outOfRange,     // a value that its definition excludes
  fragmented,     // a length of 16,384 or more, which no RRC message has
  tooDeep,        // values nested deeper than any message needs
  tooManyValues,  // more values than any message needs
};
inline constexpr std::size_t faultKindCount = 5;

struct Fault {
  FaultKind kind = FaultKind::truncated;
  std::size_t bit = 0;  // from the beginning of the message
  bool operator==(const Fault&) const = default;
};

// "the message ends inside a value"
[[nodiscard]] std::string_view textOf(FaultKind kind);

}  // namespace vespscope::rrc
