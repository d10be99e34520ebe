// The interface description of this application: its scenes, their cells, and what their rows lead to.
#pragma once

#include "platform/application/InterfaceDescription.h"

namespace vespscope {

[[nodiscard]] application::InterfaceDescription mainInterface();

}  // namespace vespscope
