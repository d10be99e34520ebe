// The quick question whether there is a modem to look at.
#pragma once

#include <chrono>

namespace vespscope::sources::modemmanager {

// Whether ModemManager runs on the system bus and has a modem, asked for at most `limit`. ModemManager is not started
// for it; without a bus the answer is no.
[[nodiscard]] bool modemManagerHasModem(std::chrono::milliseconds limit = std::chrono::milliseconds(500));

}  // namespace vespscope::sources::modemmanager
