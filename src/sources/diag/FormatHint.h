// Recognises what a file is that was given as a modem log and is none.
#pragma once

#include <cstddef>
#include <cstdint>
#include <span>
#include <string_view>

namespace vespscope::sources::diag {

// The bytes at the beginning of a file that formatHint() looks at.
inline constexpr std::size_t formatHintLength = 32;

// What the file that begins with `head` is and what to do with it, as the end of a sentence ("it is a ZIP archive: …");
// empty when it is not recognised.
[[nodiscard]] std::string_view formatHint(std::span<const std::uint8_t> head);

}  // namespace vespscope::sources::diag
