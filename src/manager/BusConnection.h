// The manager's place on the system bus, and the clients that call it there.
#pragma once

#include <map>
#include <memory>
#include <optional>
#include <string>

#include "manager/Connection.h"
#include "manager/Peer.h"
#include "rhoxlink/bus/SystemBusEnd.h"

namespace vespscope::manager {

// The users that may use the manager on the bus: the administrator, the user it runs as, and one group. The bus policy
// says the same; the manager checks it as well, in case the policy is not installed.
struct BusAccess {
  std::optional<std::uint32_t> group;

  // The members of the group of that name; if the system has no such group, nobody is added.
  static BusAccess ofGroup(const std::string& name);
  [[nodiscard]] bool admits(const bus::ClientIdentity& client) const;
};

class BusConnection final : public Connection, private bus::SystemBusEnd::Host {
 public:
  // Takes the manager's name on the system bus.
  static Result<std::unique_ptr<BusConnection>> open(ManagerCore& core, BusAccess access);

  bool work() override;
  [[nodiscard]] bool hasMore() const override { return hasMore_; }
  [[nodiscard]] bus::Wait wait() const override { return end_->wait(); }
  [[nodiscard]] std::size_t clients() const override { return clients_.size(); }
  [[nodiscard]] bool hasPlace() const override { return true; }

 private:
  struct Client {
    Client(ManagerCore& core, const bus::ClientIdentity& identity, bus::EventOutlet& way)
        : peer(core, identity), outlet(way) {}
    Peer peer;
    bus::EventOutlet& outlet;
  };

  BusConnection(ManagerCore& core, BusAccess access) : core_(core), access_(access) {}
  Result<bus::Service*> admit(const bus::ClientIdentity& client, bus::EventOutlet& outlet) override;
  void forget(const std::string& busName) override { clients_.erase(busName); }
  // Returns true when it stopped at the bound although more can be sent.
  bool sendEvents();

  ManagerCore& core_;
  const BusAccess access_;
  std::map<std::string, Client> clients_;
  bool hasMore_ = false;
  std::unique_ptr<bus::SystemBusEnd> end_;  // calls forget() for each client when it disconnects
};

}  // namespace vespscope::manager
