// Serves clients over sockets: those that connect and those it is handed, several at once, on one thread.
#pragma once

#include <atomic>
#include <memory>
#include <mutex>
#include <optional>
#include <thread>
#include <vector>

#include "manager/ListeningSocket.h"
#include "manager/ManagerCore.h"

namespace vespscope::manager {

class PeerServer {
 public:
  explicit PeerServer(std::unique_ptr<Source> source, std::optional<ConfigurationStore> store = std::nullopt,
                      DeliveryQueue::Bounds bounds = {});
  PeerServer(const PeerServer&) = delete;
  PeerServer& operator=(const PeerServer&) = delete;
  // Ends all connections and stops the source.
  ~PeerServer();

  // Accepts connections on `socket`; before start().
  void listenOn(ListeningSocket socket) { listening_.push_back(std::move(socket)); }
  // Records what the source delivers, from now on; before start().
  void recordTo(std::unique_ptr<EventRecorder> recorder) { core_.recordTo(std::move(recorder)); }
  void start();
  // Serves the other end of a connected socket, which it owns from here on. Safe from any thread.
  void adopt(int descriptor);

  [[nodiscard]] std::size_t peerCount() const { return peerCount_; }

 private:
  // One client.
  class Peer final : public bus::Service {
   public:
    Peer(ManagerCore& core) : core_(core), identifier_(core.addPeer()) {}
    Peer(const Peer&) = delete;
    Peer& operator=(const Peer&) = delete;
    ~Peer() override { core_.removePeer(identifier_); }

    bool open(int descriptor);
    // Sends what waits and answers what has come; false when the connection is over.
    bool work();
    [[nodiscard]] bus::Wait wait() const { return end_->wait(); }

    bus::Reply performCommand(const std::string& command, const ipc::Dictionary& request) override {
      return core_.performCommand(identifier_, command, request);
    }
    void eventsOn() override { core_.setEvents(identifier_, true); }
    void eventsOff() override { core_.setEvents(identifier_, false); }

   private:
    void sendEvents();

    ManagerCore& core_;
    const ManagerCore::PeerIdentifier identifier_;
    std::unique_ptr<bus::ServerEnd> end_;
  };

  void run();
  void acceptPeers();
  void addPeer(int descriptor);
  void waitForWork(std::optional<ManagerCore::Clock::time_point> until);
  void wake() const;

  const int wakeDescriptor_;
  ManagerCore core_;
  std::vector<ListeningSocket> listening_;
  std::vector<std::unique_ptr<Peer>> peers_;
  ManagerCore::Clock::time_point acceptFrom_;  // not before: the system had no descriptors
  std::atomic<std::size_t> peerCount_ = 0;
  std::atomic<bool> stopping_ = false;
  std::mutex mutex_;
  std::vector<int> adopted_;
  std::thread thread_;
};

}  // namespace vespscope::manager
