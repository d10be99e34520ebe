// What the shell knows of the connection and the decoder, as a frontend's status line shows it.
#pragma once

#include "platform/application/Status.h"

namespace vespscope {

// Reads the shared wrapper's connection and the shared decoder; call it on the main thread.
[[nodiscard]] application::StatusProvider statusProvider();

}  // namespace vespscope
