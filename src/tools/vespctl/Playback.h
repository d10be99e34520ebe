// Runs a capture's events through the decoder.
#pragma once

#include "tools/vespctl/Commands.h"

namespace vespscope {
class MetricValidator;
}

namespace vespscope::tools {

class Input;

// Processes every event of the capture; returns the error when some of it could not be read.
[[nodiscard]] Problem playInto(MetricValidator& validator, Input& input);

}  // namespace vespscope::tools
