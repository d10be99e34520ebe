// Standard output for the commands: write errors are returned.
#pragma once

#include <string_view>

#include "tools/vespctl/Commands.h"

namespace vespscope::tools {

// Writes the text and a newline.
[[nodiscard]] Problem writeLine(std::string_view text);
// Writes the buffered text.
[[nodiscard]] Problem flushOutput();

}  // namespace vespscope::tools
