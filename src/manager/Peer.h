// One client of the manager, independent of its transport.
#pragma once

#include <cstddef>
#include <memory>
#include <optional>
#include <string>

#include "manager/ManagerCore.h"
#include "rhoxlink/bus/Bus.h"

namespace vespscope::manager {

class Peer final : public bus::Service {
 public:
  // The maximum number of one client's commands that wait for the disk; each keeps its message in memory until it is
  // answered.
  static constexpr std::size_t pendingLimit = 2;

  // The client takes one of the manager's places with its first call; while none is free, all of its commands are
  // answered with CommandStatus::noPlace.
  Peer(ManagerCore& core, bus::ClientIdentity identity) : core_(core), identity_(std::move(identity)) {}
  Peer(const Peer&) = delete;
  Peer& operator=(const Peer&) = delete;
  ~Peer() override {
    if (place_) core_.removePeer(*place_);
  }

  // Whether the client has a place.
  [[nodiscard]] bool hasPlace() const { return place_.has_value(); }

  // Sends waiting events to `outlet` as long as it accepts them, at most `limit`; returns their number.
  std::size_t sendEvents(bus::EventOutlet& outlet, std::size_t limit);

  void performCommand(const std::string& command, const ipc::Dictionary& request, const Answer& answer) override;
  void eventsOn() override { setEvents(true); }
  void eventsOff() override { setEvents(false); }

 private:
  // Returns the reason if the manager has no place for the client.
  std::optional<std::string> takePlace();
  void setEvents(bool on);

  ManagerCore& core_;
  const bus::ClientIdentity identity_;
  std::optional<ManagerCore::PeerIdentifier> place_;
  bool sendsTimes_ = false;  // the client requested the events' own times
  const std::shared_ptr<std::size_t> pending_ = std::make_shared<std::size_t>(0);  // unanswered commands
};

}  // namespace vespscope::manager
