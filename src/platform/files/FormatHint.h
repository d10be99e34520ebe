// Recognises a file that was given as a recording but is of another kind.
#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>
#include <string_view>

namespace vespscope::files {

// The number of bytes at the beginning of a file that formatHint() examines.
inline constexpr std::size_t formatHintLength = 512;

// Returns the kind of a file that begins with `head` and how to use it, as the end of a sentence ("it is a ZIP archive:
// …"); empty when it is not recognised.
[[nodiscard]] std::string_view formatHint(std::span<const std::uint8_t> head);
// The same of a regular file, unpacked; empty when it cannot be read.
[[nodiscard]] std::string_view formatHintOf(const std::string& path);

}  // namespace vespscope::files
