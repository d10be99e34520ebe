// The connection to one client over a socket, or over the two pipes of standard input and output.
#pragma once

#include <memory>

#include "manager/Connection.h"
#include "manager/Peer.h"

namespace vespscope::manager {

class PeerConnection final : public Connection {
 public:
  // Takes ownership of the descriptors, which may be the same one; returns null when D-Bus does not work over them.
  // Large messages of the client share `budget` with those of others.
  static std::unique_ptr<PeerConnection> open(ManagerCore& core, int input, int output,
                                              std::shared_ptr<bus::MemoryBudget> budget = nullptr);

  bool work() override;
  [[nodiscard]] bool hasMore() const override { return hasMore_; }
  [[nodiscard]] bus::Wait wait() const override { return end_->wait(); }
  [[nodiscard]] std::size_t clients() const override { return 1; }
  [[nodiscard]] bool hasPlace() const override { return peer_.hasPlace(); }

 private:
  bool answer();
  PeerConnection(ManagerCore& core, const bus::ClientIdentity& identity) : peer_(core, identity) {}

  Peer peer_;
  std::unique_ptr<bus::ServerEnd> end_;
  bool hasMore_ = false;
};

}  // namespace vespscope::manager
