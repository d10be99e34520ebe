// Runs a capture's events through the decoder.
#pragma once

#include "tools/vespctl/Commands.h"

namespace vespscope {
class MetricValidator;
}
namespace vespscope::capture {
class CaptureReader;
}

namespace vespscope::tools {

// Processes every event of the capture; the reason when it ended early, after what came before.
[[nodiscard]] Problem playInto(MetricValidator& validator, capture::CaptureReader& reader);

}  // namespace vespscope::tools
