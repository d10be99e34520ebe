// A decoder's whole state as JSON.
#pragma once

#include "tools/vespctl/Json.h"

namespace vespscope {
class MetricValidator;
}

namespace vespscope::tools {

// The last identifier, the state holders with their field names as keys, and every stored dictionary (null while
// absent).
[[nodiscard]] Json stateOf(const MetricValidator& validator);

}  // namespace vespscope::tools
