// Waits for effects of several processes, on a machine that may be busy.
#pragma once

#include <chrono>
#include <functional>

#include "support/Eventually.h"

namespace vespscope::test {

inline bool soon(const std::function<bool()>& condition) { return eventually(condition, std::chrono::seconds(20)); }

}  // namespace vespscope::test
