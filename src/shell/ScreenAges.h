// The age of each screen's values, for the frontends.
#pragma once

#include "platform/application/ScreenAge.h"

namespace vespscope {

// Listens to the shared decoder from the main loop's first turn on. This function and the provider are for the main
// thread only.
[[nodiscard]] application::ScreenAgeProvider screenAgeProvider();

}  // namespace vespscope
