// One client as the manager serves it, however it is connected.
#pragma once

#include <cstddef>
#include <string>

#include "manager/ManagerCore.h"
#include "rhoxlink/bus/Bus.h"

namespace vespscope::manager {

class Peer final : public bus::Service {
 public:
  Peer(ManagerCore& core, const bus::ClientIdentity& identity) : core_(core), identifier_(core.addPeer(identity)) {}
  Peer(const Peer&) = delete;
  Peer& operator=(const Peer&) = delete;
  ~Peer() override { core_.removePeer(identifier_); }

  // Hands waiting events to `outlet` as long as it takes them, at most `limit`; how many it was.
  std::size_t sendEvents(bus::EventOutlet& outlet, std::size_t limit);

  void performCommand(const std::string& command, const ipc::Dictionary& request, const Answer& answer) override;
  void eventsOn() override { core_.setEvents(identifier_, true); }
  void eventsOff() override { core_.setEvents(identifier_, false); }

 private:
  ManagerCore& core_;
  const ManagerCore::PeerIdentifier identifier_;
  bool sendsTimes_ = false;  // the client asked for the events' own times
};

}  // namespace vespscope::manager
