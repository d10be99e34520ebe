// Whether the system bus has the baseband manager's name.
#pragma once

namespace vespscope::bus {

// True when somebody has the name or the bus can start whoever should; false also without a system bus.
[[nodiscard]] bool isManagerOnSystemBus();

}  // namespace vespscope::bus
