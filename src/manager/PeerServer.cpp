#include "manager/PeerServer.h"

#include <pthread.h>
#include <unistd.h>

#include <algorithm>
#include <string>
#include <utility>

#include "manager/PeerConnection.h"
#include "platform/log/Log.h"
#include "rhoxlink/bus/Waiting.h"

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
  bus::Waiting waiting;
  waiting.add(wake_.descriptor(), POLLIN);
  if (until) waiting.until(*until);
  if (acceptFrom_ > ManagerCore::Clock::now()) {
    waiting.until(acceptFrom_);
  } else {
    for (const ListeningSocket& socket : listening_) waiting.add(socket.descriptor(), POLLIN);
  }
  for (const Served& served : connections_) {
    waiting.add(served.connection->wait());
    if (served.connection->hasMore()) waiting.atMost(0us);
    if (served.waits()) waiting.until(served.since + waitingTime);
  }
  waiting.wait();
  wake_.clear();
}

}  // namespace vespscope::manager
