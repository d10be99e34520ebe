// Recognises a file that was given as a modem log but is of another kind.
#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string_view>

namespace vespscope::sources::diag {

// The number of bytes at the beginning of a file that formatHint() examines.
inline constexpr std::size_t formatHintLength = 32;

// Returns the kind of a file that begins with `head` and how to use it, as the end of a sentence ("it is a ZIP archive:
// …"); empty when it is not recognised.
[[nodiscard]] std::string_view formatHint(std::span<const std::uint8_t> head);

}  // namespace vespscope::sources::diag
