#include "manager/PeerServer.h"

#include <poll.h>
#include <pthread.h>
#include <sys/eventfd.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <string>
#include <utility>

#include "platform/log/Log.h"

namespace vespscope::manager {
namespace {

using namespace std::chrono_literals;

constexpr std::size_t peerLimit = 32;
constexpr std::size_t unsentEvents = 64;   // given to a connection beyond what its socket takes
constexpr std::size_t unsentLimit = 1024;  // answers that a client may leave unread
constexpr auto acceptPause = 100ms;        // after a failure to accept, such as too many open files

int makeWakeDescriptor() {
  const int descriptor = ::eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK);
  if (descriptor < 0) log::fatal(std::string("eventfd: ") + std::strerror(errno));
  return descriptor;
}

ipc::Dictionary toDictionary(const MetricEvent& event) {
  ipc::Dictionary dictionary;
  dictionary.set(rhox::kKeyMetricID, ipc::Object(std::int64_t{event.metricID}));
  dictionary.set(rhox::kKeyPayload, ipc::Object(event.payload));
  dictionary.set(rhox::kKeyProfileID, ipc::Object(std::int64_t{event.profileID}));
  return dictionary;
}

}  // namespace

bool PeerServer::Peer::open(int descriptor) {
  auto end = bus::ServerEnd::overSocket(descriptor, *this);
  if (!end) {
    log::system(end.reason());
    return false;
  }
  end_ = std::move(*end);
  return true;
}

bool PeerServer::Peer::work() {
  sendEvents();
  if (!end_->process()) return false;
  // A command's answer goes out before the event it asked for.
  sendEvents();
  return end_->unsent() <= unsentLimit;
}

void PeerServer::Peer::sendEvents() {
  while (end_->unsent() < unsentEvents) {
    const std::optional<DeliveryQueue::Numbered> next = core_.take(identifier_);
    if (!next) return;
    // What cannot be sent leaves its number out; a connection that is over shows in process().
    end_->sendEvent(rhox::kEventMetric, next->sequence, toDictionary(*next->event));
  }
}

PeerServer::PeerServer(std::unique_ptr<Source> source, std::optional<ConfigurationStore> store,
                       DeliveryQueue::Bounds bounds)
    : wakeDescriptor_(makeWakeDescriptor()),
      core_(
          std::move(source), [this] { wake(); }, std::move(store), bounds) {}

PeerServer::~PeerServer() {
  stopping_ = true;
  wake();
  if (thread_.joinable()) thread_.join();
  for (const int descriptor : adopted_) ::close(descriptor);
  peers_.clear();
  core_.stop();
  ::close(wakeDescriptor_);
}

void PeerServer::start() {
  thread_ = std::thread([this] { run(); });
  ::pthread_setname_np(thread_.native_handle(), "manager");
}

void PeerServer::adopt(int descriptor) {
  {
    const std::lock_guard lock(mutex_);
    adopted_.push_back(descriptor);
  }
  wake();
}

void PeerServer::wake() const {
  const std::uint64_t one = 1;
  while (::write(wakeDescriptor_, &one, sizeof one) < 0 && errno == EINTR) {
  }
}

void PeerServer::run() {
  while (!stopping_) {
    acceptPeers();
    const auto until = core_.collectDue(ManagerCore::Clock::now());
    std::erase_if(peers_, [](const std::unique_ptr<Peer>& peer) { return !peer->work(); });
    peerCount_ = peers_.size();
    waitForWork(until);
  }
}

void PeerServer::acceptPeers() {
  std::vector<int> adopted;
  {
    const std::lock_guard lock(mutex_);
    adopted.swap(adopted_);
  }
  for (const int descriptor : adopted) addPeer(descriptor);
  if (ManagerCore::Clock::now() < acceptFrom_) return;
  for (const ListeningSocket& socket : listening_) {
    ListeningSocket::Accepted next = socket.accept();
    for (; next.outcome == ListeningSocket::Outcome::accepted; next = socket.accept()) addPeer(next.descriptor);
    if (next.outcome == ListeningSocket::Outcome::exhausted) acceptFrom_ = ManagerCore::Clock::now() + acceptPause;
  }
}

void PeerServer::addPeer(int descriptor) {
  if (peers_.size() >= peerLimit) {
    log::system("refused a connection: " + std::to_string(peerLimit) + " clients are connected");
    ::close(descriptor);
    return;
  }
  auto peer = std::make_unique<Peer>(core_);
  if (!peer->open(descriptor)) return;
  peers_.push_back(std::move(peer));
  peerCount_ = peers_.size();
}

void PeerServer::waitForWork(std::optional<ManagerCore::Clock::time_point> until) {
  std::vector<pollfd> ready;
  ready.push_back({wakeDescriptor_, POLLIN, 0});
  std::optional<std::chrono::microseconds> timeout;
  const auto atMost = [&timeout](std::chrono::microseconds limit) {
    timeout = std::max(std::min(timeout.value_or(limit), limit), 0us);
  };
  if (until) {
    // Rounded up, so that what is due is found due.
    atMost(std::chrono::ceil<std::chrono::microseconds>(*until - ManagerCore::Clock::now()));
  }
  if (const auto pause = acceptFrom_ - ManagerCore::Clock::now(); pause > 0us) {
    atMost(std::chrono::ceil<std::chrono::microseconds>(pause));
  } else {
    for (const ListeningSocket& socket : listening_) ready.push_back({socket.descriptor(), POLLIN, 0});
  }
  for (const auto& peer : peers_) {
    const bus::Wait wait = peer->wait();
    if (wait.descriptor >= 0) ready.push_back({wait.descriptor, wait.events, 0});
    if (wait.timeout >= 0us) atMost(wait.timeout);
  }
  timespec limit{};
  if (timeout) {
    const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(*timeout);
    limit.tv_sec = static_cast<time_t>(seconds.count());
    limit.tv_nsec = static_cast<long>(std::chrono::nanoseconds(*timeout - seconds).count());
  }
  ::ppoll(ready.data(), ready.size(), timeout ? &limit : nullptr, nullptr);
  std::uint64_t wakes = 0;
  [[maybe_unused]] const ssize_t ignored = ::read(wakeDescriptor_, &wakes, sizeof wakes);  // empty is as good as read
}

}  // namespace vespscope::manager
