// Opens the connection to the manager at an address.
#pragma once

#include <functional>
#include <memory>
#include <string>

#include "rhoxlink/Address.h"
#include "rhoxlink/bus/Bus.h"
#include "rhoxlink/bus/Embedded.h"
#include "values/Result.h"

namespace rhox::client {

struct Link {
  std::shared_ptr<void> keeper;  // keeps the other end alive; outlives `end`
  std::unique_ptr<vespscope::bus::ClientEnd> end;
  std::function<std::string()> explainEnd;  // returns why the other end closed, if that is known
};

// Returns a started connection, or why there is none. Does not wait for the other end.
vespscope::Result<Link> openLink(const Address& address, const vespscope::bus::EmbeddedFactory& factory,
                                 vespscope::bus::ClientEnd::EventHandler onEvent);

// The checks by which `auto` finds a manager; an empty probe finds nothing.
struct AutomaticProbes {
  std::function<bool()> serviceOnSystemBus;
  std::function<bool()> modem;  // whether the embedded source "modemmanager" has a modem
};

// Resolves `auto`: the service on the system bus, else a manager inside the process with this machine's modem, else one
// with a simulated drive.
[[nodiscard]] Address resolveAutomatic(const AutomaticProbes& probes);

}  // namespace rhox::client
