// Whether two metric payloads say the same, whenever they said it.
#pragma once

#include "values/Value.h"

namespace vespscope::manager {

// True when the payloads are equal but for their field 1, the timestamp in every metric message. A payload that is
// not in the Protocol Buffers wire format is compared as it stands.
[[nodiscard]] bool sameButForTimestamp(const Bytes& one, const Bytes& other);

}  // namespace vespscope::manager
