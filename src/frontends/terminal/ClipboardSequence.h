// The control sequence that asks a terminal to put a text into its user's clipboard (OSC 52).
#pragma once

#include <string>
#include <string_view>

namespace vespscope::terminal {

// The sequence for `text`, which travels in base64 (RFC 4648, section 4), so that no byte of it acts on the terminal.
[[nodiscard]] std::string clipboardSequence(std::string_view text);

}  // namespace vespscope::terminal
