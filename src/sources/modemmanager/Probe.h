// A quick check whether there is a modem to follow.
#pragma once

#include <chrono>
#include <optional>
#include <string>

namespace vespscope::sources::modemmanager {

// Whether ModemManager runs on the system bus and has a modem; waits at most `limit`. Does not start ModemManager;
// without a bus returns false.
[[nodiscard]] bool modemManagerHasModem(std::chrono::milliseconds limit = std::chrono::milliseconds(500));

// What ModemManager says about a port of the machine.
struct ModemManagerPort {
  bool running = false;               // ModemManager, on the system bus
  std::optional<std::string> modem;   // the number of the modem that the port belongs to, as mmcli -m takes it
  std::optional<std::string> device;  // that modem's device, as mmcli --inhibit-device takes it
};

// Asks like modemManagerHasModem() for the modem that has the port `name`, such as "ttyUSB0".
[[nodiscard]] ModemManagerPort modemManagerPort(const std::string& name,
                                                std::chrono::milliseconds limit = std::chrono::milliseconds(500));

}  // namespace vespscope::sources::modemmanager
