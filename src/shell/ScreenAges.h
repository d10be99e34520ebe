// The age of each screen's values, for the frontends.
#pragma once

#include <memory>

#include "platform/application/ScreenAge.h"

namespace vespscope {

class SimSwitch;

// Listens to the shared decoder from the main loop's first turn on. This function and the provider are for the main
// thread only. `sims` may be null.
[[nodiscard]] application::ScreenAgeProvider screenAgeProvider(const std::shared_ptr<SimSwitch>& sims = nullptr);

}  // namespace vespscope
