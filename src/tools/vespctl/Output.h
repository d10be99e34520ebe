// Standard output as the commands write it: a failure to write is returned, not lost.
#pragma once

#include <string_view>

#include "tools/vespctl/Commands.h"

namespace vespscope::tools {

// Writes the text and a line end.
[[nodiscard]] Problem writeLine(std::string_view text);
// Brings out what is still buffered.
[[nodiscard]] Problem flushOutput();

}  // namespace vespscope::tools
