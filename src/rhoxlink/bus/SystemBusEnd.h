// The manager's end on the system bus: owns the manager's name there and tells its clients apart.
#pragma once

#include <map>
#include <memory>
#include <string>

#include "rhoxlink/bus/Bus.h"

namespace vespscope::bus {

class SystemBusEnd final : public ServingEnd {
 public:
  // Whoever serves the clients; called from process().
  class Host {
   public:
    virtual ~Host() = default;
    // The service of a client that calls for the first time, or why it gets none. Service and outlet last until
    // forget().
    virtual Result<Service*> admit(const ClientIdentity& client, EventOutlet& outlet) = 0;
    // The client has left the bus.
    virtual void forget(const std::string& busName) = 0;
  };

  // Connects to the system bus and takes the name. `host` outlives it.
  static Result<std::unique_ptr<SystemBusEnd>> open(Host& host);
  ~SystemBusEnd() override;

 private:
  class Client;
  friend struct SystemBusCallbacks;

  SystemBusEnd(Handle bus, Host& host);
  Result<Service*> serviceFor(sd_bus_message* call) override;
  [[nodiscard]] Result<ClientIdentity> identify(const std::string& busName);

  Host& host_;
  std::map<std::string, std::unique_ptr<Client>, std::less<>> clients_;
};

}  // namespace vespscope::bus
