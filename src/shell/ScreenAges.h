// How current each screen's values are, for the frontends.
#pragma once

#include "platform/application/ScreenAge.h"

namespace vespscope {

// Listens to the shared decoder from the main loop's first turn on. Call it, and the provider, on the main thread.
[[nodiscard]] application::ScreenAgeProvider screenAgeProvider();

}  // namespace vespscope
