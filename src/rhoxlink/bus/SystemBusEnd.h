// The manager's end on the system bus: owns the manager's name there and distinguishes its clients.
#pragma once

#include <map>
#include <memory>
#include <string>

#include "rhoxlink/bus/Bus.h"

namespace vespscope::bus {

class SystemBusEnd final : public ServingEnd {
 public:
  // Serves the clients; called from process().
  class Host {
   public:
    virtual ~Host() = default;
    // Returns the service of a client that calls for the first time, or why it is rejected. Service and outlet must
    // exist until forget().
    virtual Result<Service*> admit(const ClientIdentity& client, EventOutlet& outlet) = 0;
    // The client has left the bus.
    virtual void forget(const std::string& busName) = 0;
  };

  // Connects to the system bus and takes the name. `host` must outlive this object.
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
