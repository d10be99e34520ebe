#include "EventServer.h"

#include <poll.h>
#include <sys/eventfd.h>
#include <sys/socket.h>
#include <unistd.h>

#include <array>
#include <utility>

#include "platform/log/Log.h"
#include "rhoxlink/Rhoxlink.h"

namespace vespscope::test {

namespace {

// The client's end until it is taken. A connection that outlives a server, like that of the shared wrapper, finds the
// next server's end here.
std::mutex offerMutex;
int offeredDescriptor = -1;

void offer(int descriptor) {
  const std::lock_guard lock(offerMutex);
  if (offeredDescriptor >= 0) close(offeredDescriptor);
  offeredDescriptor = descriptor;
}

Result<bus::EmbeddedEnd> takeOffered(const std::string& /*source*/) {
  const std::lock_guard lock(offerMutex);
  if (offeredDescriptor < 0) return Failure{std::string("the test has no manager")};
  return bus::EmbeddedEnd{std::exchange(offeredDescriptor, -1), nullptr};
}

}  // namespace

EventServer::EventServer() : wakeDescriptor_(eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK)) {
  std::array<int, 2> ends = {-1, -1};
  if (socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0, ends.data()) != 0) log::fatal("no socket pair");
  offer(ends[0]);
  rhox::client::setEmbeddedFactory(&takeOffered);
  rhox::client::setAddress({rhox::client::Address::Kind::embedded, "test"});
  thread_ = std::thread([this, descriptor = ends[1]] { run(descriptor); });
}

EventServer::~EventServer() {
  {
    const std::lock_guard lock(mutex_);
    stopping_ = true;
  }
  eventfd_write(wakeDescriptor_, 1);
  thread_.join();
  offer(-1);
  close(wakeDescriptor_);
}

bool EventServer::waitUntilEventsOn(std::chrono::milliseconds limit) {
  std::unique_lock lock(mutex_);
  return changed_.wait_for(lock, limit, [this] { return on_; });
}

void EventServer::send(std::string_view kind, ipc::Dictionary event) {
  {
    const std::lock_guard lock(mutex_);
    events_.push_back({std::string(kind), std::move(event)});
  }
  eventfd_write(wakeDescriptor_, 1);
}

void EventServer::performCommand(const std::string& /*command*/, const ipc::Dictionary& /*request*/,
                                 const Answer& answer) {
  answer({});
}

void EventServer::eventsOn() {
  const std::lock_guard lock(mutex_);
  on_ = true;
  changed_.notify_all();
}

void EventServer::eventsOff() {
  const std::lock_guard lock(mutex_);
  on_ = false;
}

void EventServer::run(int descriptor) {
  auto end = bus::ServerEnd::overSocket(descriptor, *this);
  if (!end) log::fatal(end.reason());
  for (std::uint64_t sequence = 0;;) {
    std::vector<Event> events;
    {
      const std::lock_guard lock(mutex_);
      if (stopping_) return;
      events = std::exchange(events_, {});
    }
    for (const Event& event : events) (*end)->sendEvent(event.kind, ++sequence, event.dictionary);
    if (!(*end)->process()) return;
    const bus::Wait wait = (*end)->wait();
    std::array<pollfd, 2> polled = {{{wait.descriptor, wait.events, 0}, {wakeDescriptor_, POLLIN, 0}}};
    poll(polled.data(), polled.size(), wait.timeout.count() < 0 ? -1 : static_cast<int>(wait.timeout.count() / 1000));
    eventfd_t ignored = 0;
    eventfd_read(wakeDescriptor_, &ignored);
  }
}

ipc::Dictionary metricEvent(std::int64_t identifier, Bytes payload) {
  ipc::Dictionary event;
  event.set(rhox::kKeyMetricID, ipc::Object(identifier));
  event.set(rhox::kKeyPayload, ipc::Object(std::move(payload)));
  event.set(rhox::kKeyProfileID, ipc::Object(std::int64_t{0}));
  return event;
}

}  // namespace vespscope::test
