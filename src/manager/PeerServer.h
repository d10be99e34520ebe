// Serves clients, several at once, on one thread: those that connect to its sockets, those it is handed, and those on
// the system bus.
#pragma once

#include <atomic>
#include <chrono>
#include <cstddef>
#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <thread>
#include <utility>
#include <vector>

#include "manager/BusConnection.h"
#include "manager/Connection.h"
#include "manager/ListeningSocket.h"
#include "manager/ManagerCore.h"
#include "platform/dispatch/WakeDescriptor.h"

namespace vespscope::manager {

class PeerServer {
 public:
  // Connections without a place: those that have not called yet, and those that were refused one. The oldest gives way
  // to a new one, and each is closed after a time.
  static constexpr std::size_t waitingLimit = 32;
  static constexpr std::chrono::seconds waitingTime{10};

  explicit PeerServer(std::unique_ptr<sources::Source> source, std::optional<ConfigurationStore> store = std::nullopt,
                      DeliveryQueue::Bounds bounds = {});
  PeerServer(const PeerServer&) = delete;
  PeerServer& operator=(const PeerServer&) = delete;
  // Ends all connections and stops the source.
  ~PeerServer();

  // Accepts connections on `socket`; before start().
  void listenOn(ListeningSocket socket) { listening_.push_back(std::move(socket)); }
  // Records what the source delivers, from now on; before start().
  void recordTo(std::unique_ptr<EventRecorder> recorder) { core_.recordTo(std::move(recorder)); }
  // Takes the manager's name on the system bus and serves the clients there; before start(). Returns the reason when
  // another has the name or the bus does not grant it.
  [[nodiscard]] std::optional<std::string> serveSystemBus(BusAccess access);
  void start();
  // Serves the client at the other end of a connected socket, and owns the descriptor from here on. Safe from any
  // thread.
  void adopt(int descriptor) { adopt(descriptor, descriptor); }
  // The same for what is read from one descriptor and written to another.
  void adopt(int input, int output);
  // `ended` is called, on the server's thread, when the system bus or an adopted connection is over; before start().
  void onEnd(std::function<void()> ended) { ended_ = std::move(ended); }

  [[nodiscard]] std::size_t peerCount() const { return peerCount_; }

 private:
  void run();
  struct Descriptors {
    int input;
    int output;
  };
  struct Served {
    std::unique_ptr<Connection> connection;
    bool told = false;  // its end is reported by ended_, and it may be silent for as long as it likes
    ManagerCore::Clock::time_point since = ManagerCore::Clock::now();

    [[nodiscard]] bool waits() const { return !told && !connection->hasPlace(); }
  };

  static void close(const Descriptors& descriptors);
  void acceptPeers();
  void addPeer(Descriptors descriptors, bool told);
  // Closes the connection that has been without a place for longest, when as many are as may be.
  void makeRoom();
  void work();
  [[nodiscard]] std::size_t countPeers() const;
  void waitForWork(std::optional<ManagerCore::Clock::time_point> until);

  const dispatch::WakeDescriptor wake_;
  const std::shared_ptr<bus::MemoryBudget> budget_;  // of all clients' large messages
  ManagerCore core_;
  std::vector<ListeningSocket> listening_;
  std::vector<Served> connections_;
  std::function<void()> ended_;
  ManagerCore::Clock::time_point acceptFrom_;  // not before: the system had no descriptors
  std::atomic<std::size_t> peerCount_ = 0;
  std::atomic<bool> stopping_ = false;
  std::mutex mutex_;
  std::vector<Descriptors> adopted_;
  std::thread thread_;
};

}  // namespace vespscope::manager
