// Compares metric payloads apart from their timestamps.
#pragma once

#include "values/Value.h"

namespace vespscope::manager {

// Whether the payloads are equal except for field 1, which is the timestamp in every metric message. A payload that is
// not in the Protocol Buffers wire format is compared byte by byte.
[[nodiscard]] bool sameButForTimestamp(const Bytes& one, const Bytes& other);

}  // namespace vespscope::manager
