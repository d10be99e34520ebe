// A quick check whether there is a modem to follow.
#pragma once

#include <chrono>

namespace vespscope::sources::modemmanager {

// Whether ModemManager runs on the system bus and has a modem; waits at most `limit`. Does not start ModemManager;
// without a bus returns false.
[[nodiscard]] bool modemManagerHasModem(std::chrono::milliseconds limit = std::chrono::milliseconds(500));

}  // namespace vespscope::sources::modemmanager
