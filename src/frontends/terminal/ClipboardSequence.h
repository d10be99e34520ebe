// The control sequence that makes a terminal put a text into its user's clipboard (OSC 52).
#pragma once

#include <string>
#include <string_view>

namespace vespscope::terminal {

// Returns the sequence for `text`, encoded in base64 (RFC 4648, section 4), so that the terminal interprets none of its
// bytes.
[[nodiscard]] std::string clipboardSequence(std::string_view text);

}  // namespace vespscope::terminal
