// Runs a capture's events through the decoder.
#pragma once

#include "tools/vespctl/Commands.h"

namespace vespscope {
class MetricValidator;
}

namespace vespscope::tools {

class Input;

// Processes the capture's events, of several SIM cards those of one, chosen as in a viewer; returns the error when some
// of the capture could not be read.
[[nodiscard]] Problem playInto(MetricValidator& validator, Input& input);

}  // namespace vespscope::tools
