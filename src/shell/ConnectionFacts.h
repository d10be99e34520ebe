// The shell's facts about the connection and the decoder, for a frontend's status line.
#pragma once

#include <memory>

#include "platform/application/Status.h"

namespace vespscope {

class SimSwitch;

// Reads the shared wrapper's connection and the shared decoder; for the main thread only. `sims` may be null.
[[nodiscard]] application::StatusProvider statusProvider(std::shared_ptr<const SimSwitch> sims = nullptr);

}  // namespace vespscope
