#include "manager/PeerServer.h"

#include <poll.h>
#include <pthread.h>
#include <unistd.h>

#include <algorithm>
#include <string>
#include <utility>

#include "manager/PeerConnection.h"
#include "platform/log/Log.h"

namespace vespscope::manager {
namespace {

using namespace std::chrono_literals;

constexpr auto acceptPause = 100ms;                          // after a failure to accept, such as too many open files
constexpr std::size_t messageBudget = std::size_t{4} << 20;  // bytes of large messages in progress
constexpr int acceptTurn = 4;                                // connections accepted before the clients' turn

}  // namespace

PeerServer::PeerServer(std::unique_ptr<sources::Source> source, std::optional<ConfigurationStore> store,
                       DeliveryQueue::Bounds bounds)
    : budget_(std::make_shared<bus::MemoryBudget>(messageBudget)),
      core_(
          std::move(source), [this] { wake_.wake(); }, std::move(store), bounds) {}

PeerServer::~PeerServer() {
  stopping_ = true;
  wake_.wake();
  if (thread_.joinable()) thread_.join();
  for (const Descriptors& adopted : adopted_) close(adopted);
  connections_.clear();
  core_.stop();
}

void PeerServer::close(const Descriptors& descriptors) {
  ::close(descriptors.input);
  if (descriptors.output != descriptors.input) ::close(descriptors.output);
}

void PeerServer::start() {
  thread_ = std::thread([this] { run(); });
  ::pthread_setname_np(thread_.native_handle(), "manager");
}

std::optional<std::string> PeerServer::serveSystemBus(BusAccess access) {
  auto connection = BusConnection::open(core_, access);
  if (!connection) return connection.reason();
  connections_.push_back({std::move(*connection), true});
  return std::nullopt;
}

void PeerServer::adopt(int input, int output) {
  {
    const std::lock_guard lock(mutex_);
    adopted_.push_back({input, output});
  }
  wake_.wake();
}

void PeerServer::run() {
  while (!stopping_) {
    acceptPeers();
    const auto until = core_.collectDue(ManagerCore::Clock::now());
    core_.sendAnswers();
    work();
    waitForWork(until);
  }
}

void PeerServer::work() {
  bool toldEnd = false;
  const auto now = ManagerCore::Clock::now();
  std::erase_if(connections_, [this, &toldEnd, now](const Served& served) {
    if (served.connection->work()) {
      if (!served.waits() || now < served.since + waitingTime) return false;
      core_.refusals().write("closed a connection without a place after " + std::to_string(waitingTime.count()) + " s");
      return true;
    }
    toldEnd = toldEnd || served.told;
    return true;
  });
  peerCount_ = countPeers();
  if (toldEnd && ended_) ended_();
}

std::size_t PeerServer::countPeers() const {
  std::size_t count = 0;
  for (const Served& served : connections_) count += served.connection->clients();
  return count;
}

void PeerServer::acceptPeers() {
  std::vector<Descriptors> adopted;
  {
    const std::lock_guard lock(mutex_);
    adopted.swap(adopted_);
  }
  for (const Descriptors& descriptors : adopted) addPeer(descriptors, true);
  if (ManagerCore::Clock::now() < acceptFrom_) return;
  for (const ListeningSocket& socket : listening_) {
    ListeningSocket::Accepted next;
    for (int count = 0; count < acceptTurn; ++count) {
      next = socket.accept();
      if (next.outcome == ListeningSocket::Outcome::accepted) addPeer({next.descriptor, next.descriptor}, false);
      if (next.outcome == ListeningSocket::Outcome::refused) core_.refusals().write(next.refusal);
      if (next.outcome == ListeningSocket::Outcome::noneWaits) break;
      if (next.outcome == ListeningSocket::Outcome::exhausted) break;
    }
    if (next.outcome == ListeningSocket::Outcome::exhausted) acceptFrom_ = ManagerCore::Clock::now() + acceptPause;
  }
}

void PeerServer::addPeer(Descriptors descriptors, bool told) {
  if (!told) makeRoom();
  auto connection = PeerConnection::open(core_, descriptors.input, descriptors.output, budget_);
  if (!connection) {
    if (told && ended_) ended_();
    return;
  }
  connections_.push_back({std::move(connection), told});
  peerCount_ = countPeers();
}

void PeerServer::makeRoom() {
  const auto waits = [](const Served& served) { return served.waits(); };
  if (static_cast<std::size_t>(std::count_if(connections_.begin(), connections_.end(), waits)) < waitingLimit) return;
  core_.refusals().write("closed a connection without a place for a new one");
  connections_.erase(std::find_if(connections_.begin(), connections_.end(), waits));  // they are ordered by age
}

void PeerServer::waitForWork(std::optional<ManagerCore::Clock::time_point> until) {
  std::vector<pollfd> ready;
  ready.push_back({wake_.descriptor(), POLLIN, 0});
  std::optional<std::chrono::microseconds> timeout;
  const auto atMost = [&timeout](std::chrono::microseconds limit) {
    timeout = std::max(std::min(timeout.value_or(limit), limit), 0us);
  };
  if (until) {
    // Rounded up, so that events are due when the wait ends.
    atMost(std::chrono::ceil<std::chrono::microseconds>(*until - ManagerCore::Clock::now()));
  }
  if (const auto pause = acceptFrom_ - ManagerCore::Clock::now(); pause > 0us) {
    atMost(std::chrono::ceil<std::chrono::microseconds>(pause));
  } else {
    for (const ListeningSocket& socket : listening_) ready.push_back({socket.descriptor(), POLLIN, 0});
  }
  for (const Served& served : connections_) {
    const bus::Wait wait = served.connection->wait();
    if (wait.descriptor >= 0) ready.push_back({wait.descriptor, wait.events, 0});
    if (wait.outputDescriptor >= 0) ready.push_back({wait.outputDescriptor, wait.outputEvents, 0});
    if (wait.timeout >= 0us) atMost(wait.timeout);
    if (served.connection->hasMore()) atMost(0us);
    if (served.waits()) {
      atMost(std::chrono::ceil<std::chrono::microseconds>(served.since + waitingTime - ManagerCore::Clock::now()));
    }
  }
  timespec limit{};
  if (timeout) {
    const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(*timeout);
    limit.tv_sec = static_cast<time_t>(seconds.count());
    limit.tv_nsec = static_cast<long>(std::chrono::nanoseconds(*timeout - seconds).count());
  }
  ::ppoll(ready.data(), ready.size(), timeout ? &limit : nullptr, nullptr);
  wake_.clear();
}

}  // namespace vespscope::manager
