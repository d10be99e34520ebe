// Serves several clients at once on one thread: those that connect to its sockets, adopted connections, and those on
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
  // The maximum number of connections without a place: before their first call, or rejected. A new connection replaces
  // the oldest, and each is closed after a time.
  static constexpr std::size_t waitingLimit = 32;
  static constexpr std::chrono::seconds waitingTime{10};

  explicit PeerServer(std::unique_ptr<sources::Source> source, std::optional<ConfigurationStore> store = std::nullopt,
                      DeliveryQueue::Bounds bounds = {});
  PeerServer(const PeerServer&) = delete;
  PeerServer& operator=(const PeerServer&) = delete;
  // Closes all connections and stops the source.
  ~PeerServer();

  // Accepts connections on `socket`; called before start().
  void listenOn(ListeningSocket socket) { listening_.push_back(std::move(socket)); }
  // Records everything that the source delivers; called before start().
  void recordTo(std::unique_ptr<EventRecorder> recorder) { core_.recordTo(std::move(recorder)); }
  // Takes the manager's name on the system bus and serves the clients there; called before start(). Returns the error
  // if another process has the name or the bus denies it.
  [[nodiscard]] std::optional<std::string> serveSystemBus(BusAccess access);
  void start();
  // Serves the client at the other end of a connected socket; takes ownership of the descriptor. Safe from any thread.
  void adopt(int descriptor) { adopt(descriptor, descriptor); }
  // The same for a client whose messages are read from one descriptor and written to another.
  void adopt(int input, int output);
  // `ended` is called, on the server's thread, when the system bus or an adopted connection ends; set before start().
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
    bool told = false;  // ended_ reports its end, and it is not closed when idle
    ManagerCore::Clock::time_point since = ManagerCore::Clock::now();

    [[nodiscard]] bool waits() const { return !told && !connection->hasPlace(); }
  };

  static void close(const Descriptors& descriptors);
  void acceptPeers();
  void addPeer(Descriptors descriptors, bool told);
  // Closes the oldest connection without a place when their number has reached the limit.
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
  ManagerCore::Clock::time_point acceptFrom_;  // accept nothing before: the system had no descriptors
  std::atomic<std::size_t> peerCount_ = 0;
  std::atomic<bool> stopping_ = false;
  std::mutex mutex_;
  std::vector<Descriptors> adopted_;
  std::thread thread_;
};

}  // namespace vespscope::manager
