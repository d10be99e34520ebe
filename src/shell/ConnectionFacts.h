// The shell's facts about the connection and the decoder, for a frontend's status line.
#pragma once

#include "platform/application/Status.h"

namespace vespscope {

// Reads the shared wrapper's connection and the shared decoder; for the main thread only.
[[nodiscard]] application::StatusProvider statusProvider();

}  // namespace vespscope
