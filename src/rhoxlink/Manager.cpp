#include "rhoxlink/Manager.h"

#include <poll.h>
#include <pthread.h>

#include <algorithm>
#include <array>
#include <utility>

#include "platform/dispatch/SerialQueue.h"
#include "rhoxlink/Connector.h"

namespace rhox::client {
namespace {

using namespace std::chrono_literals;
using vespscope::bus::Reply;
using vespscope::ipc::Dictionary;
using vespscope::ipc::Object;

constexpr std::chrono::milliseconds firstBackoff = 100ms;
constexpr std::chrono::milliseconds longestBackoff = 1s;
// What starts a program on this machine or another with each attempt is not tried as often.
constexpr std::chrono::milliseconds longestCostlyBackoff = 15s;
// How long the first answer may take where a manager is started or a machine reached first.
constexpr auto startPatience = 15s;
// How often a live source is asked what it is: its label tells the modem's state.
constexpr auto livePause = 1s;
// How long an answer may come after its caller went away; until then the connection remembers the call.
constexpr auto forgetAfter = 1min;

// Messages that are read before their events are handed over, all together.
constexpr int turn = 64;

}  // namespace

Manager::Manager(std::string name, vespscope::Result<Address> address, vespscope::bus::EmbeddedFactory factory,
                 std::shared_ptr<vespscope::dispatch::SerialQueue> queue, Afterwards afterwards)
    : name_(std::move(name)),
      address_(std::move(address)),
      factory_(std::move(factory)),
      queue_(std::move(queue)),
      inbox_(std::make_shared<EventInbox>(queue_, std::move(afterwards))),
      backoff_(firstBackoff) {
  inbox_->setRoomHandler([this] { wake_.wake(); });
  connect();
  thread_ = std::thread([this] { run(); });
  ::pthread_setname_np(thread_.native_handle(), "rhoxlink");
}

Manager::~Manager() {
  {
    const std::lock_guard lock(mutex_);
    stopping_ = true;
  }
  wake_.wake();
  thread_.join();
  inbox_->setRoomHandler(nullptr);
  link_ = {};
}

Result Manager::perform(std::string_view command, const Dictionary& request, Object& reply,
                        std::chrono::milliseconds timeout) {
  const auto call = std::make_shared<Call>();
  call->command = command;
  call->request = request;
  const Clock::time_point begin = Clock::now();
  call->deadline = begin + timeout;
  std::unique_lock lock(mutex_);
  if (const Object* application = request.find(kKeyAppID);
      application != nullptr && application->asInt64() != nullptr) {
    application_ = *application->asInt64();
  }
  if (!linked_) return {kStatusNotConnected, "not connected to a baseband manager: " + status_.problem};
  operations_.push_back({call, false});
  lock.unlock();
  wake_.wake();
  lock.lock();
  while (!answered_.wait_until(lock, call->deadline, [&call] { return call->reply.has_value(); })) {
    if (!status_.connected && takesItsTime() && Clock::now() < begin + startPatience) {
      // The time counts from the manager's first answer on.
      answered_.wait_until(lock, begin + startPatience,
                           [this, &call] { return call->reply.has_value() || status_.connected; });
      call->deadline = Clock::now() + timeout;
      continue;
    }
    call->abandoned = true;
    return {kStatusTimedOut, "the baseband manager did not answer within " + std::to_string(timeout.count()) + " ms"};
  }
  reply = Object(std::move(call->reply->values));
  return {call->reply->status, std::move(call->reply->message)};
}

void Manager::setEvents(bool on) {
  {
    const std::lock_guard lock(mutex_);
    if (linked_) {
      operations_.push_back({nullptr, on});
    } else {
      delivering_ = on;  // told to the manager with the next connection
    }
  }
  wake_.wake();
}

ConnectionStatus Manager::status() const {
  const std::lock_guard lock(mutex_);
  ConnectionStatus status = status_;
  status.eventsLost += inbox_->dropped();
  return status;
}

void Manager::run() {
  while (true) {
    {
      const std::lock_guard lock(mutex_);
      if (stopping_) return;
    }
    if ((!link_.end || waitsForName_) && Clock::now() >= nextAttempt_) connect();
    if (link_.end && !waitsForName_) {
      sendOperations();
      askForSource();
    }
    if (link_.end && !heldBack() && !work()) {
      if (waitsForName_) backoff_ = firstBackoff;  // somebody has the name now
      disconnect(whyEnded());
    }
    if (!refusal_.empty()) waitForName();
    waitForWork();
  }
}

// A manager that is started by hand is noticed at once, so the bus is seldom asked again to start one.
void Manager::waitForName() {
  const std::string problem = std::exchange(refusal_, {});
  if (!link_.end) return;
  waitsForName_ = true;
  scheduleAttempt();
  disconnectOperations(problem);
}

void Manager::scheduleAttempt() {
  nextAttempt_ = Clock::now() + backoff_;
  backoff_ = std::min(backoff_ * 2, takesItsTime() ? longestCostlyBackoff : longestBackoff);
}

// Whether a manager is started, or another machine reached, before it answers.
bool Manager::takesItsTime() const {
  return address_ && (address_->kind == Address::Kind::system || address_->kind == Address::Kind::ssh);
}

std::string Manager::whyEnded() const {
  if (link_.explainEnd) return link_.explainEnd();
  return link_.end->ending().empty() ? "the manager closed the connection" : link_.end->ending();
}

bool Manager::work() {
  const std::uint64_t before = link_.end->malformedEvents();
  const bool open = link_.end->process(turn);
  handOverEvents();
  if (const std::uint64_t skipped = link_.end->malformedEvents() - before; skipped != 0) {
    const std::lock_guard lock(mutex_);
    status_.malformed += skipped;
  }
  return open;
}

void Manager::connect() {
  waitsForName_ = false;
  link_ = {};
  const auto onEvent = [this](std::string_view kind, std::uint64_t sequence, Dictionary event) {
    receive(kind, sequence, std::move(event));
  };
  vespscope::Result<Link> link =
      address_ ? openLink(*address_, factory_, onEvent) : vespscope::Failure{address_.reason()};
  if (!link) return disconnect(link.reason());
  link_ = std::move(*link);
  nextSequence_ = 1;
  nextQuestion_ = Clock::time_point::max();
  sayHello();
  bool delivering = false;
  {
    const std::lock_guard lock(mutex_);
    linked_ = true;
    delivering = delivering_;
  }
  if (delivering) link_.end->setEvents(true);
}

void Manager::sayHello() {
  Dictionary request;
  {
    const std::lock_guard lock(mutex_);
    if (application_) request.set(kKeyAppID, Object(*application_));
  }
  request.set(kKeyClientName, Object(name_));
  // Waits as long as it takes: nobody waits for it, and its answer proves the connection.
  link_.end->performCommand(std::string(kCommandStatus), request, 24h,
                            [this](const Reply& reply) { learnSource(reply); });
}

void Manager::learnSource(const Reply& reply) {
  if (reply.status == kStatusConnectionLost || reply.status == kStatusTimedOut) return;
  if (reply.status == kStatusNoManager || reply.status == kStatusAccessDenied) {
    refusal_ = reply.message;
    return;
  }
  backoff_ = firstBackoff;
  takeSource(reply);
  const std::lock_guard lock(mutex_);
  status_.connected = true;
  status_.problem.clear();
  ++status_.connections;
  answered_.notify_all();  // for those who wait for the manager to start
}

void Manager::takeSource(const Reply& reply) {
  const Object* label = reply.values.find(kKeySourceLabel);
  const Object* kind = reply.values.find(kKeySourceKind);
  const std::lock_guard lock(mutex_);
  status_.sourceLabel = label != nullptr && label->asString() != nullptr ? *label->asString() : std::string();
  status_.sourceKind = kind != nullptr && kind->asString() != nullptr ? vespscope::sourceKindOf(*kind->asString())
                                                                      : vespscope::SourceKind::unknown;
  if (status_.sourceKind == vespscope::SourceKind::live) nextQuestion_ = Clock::now() + livePause;
}

void Manager::askForSource() {
  if (Clock::now() < nextQuestion_) return;
  nextQuestion_ = Clock::time_point::max();  // until it is answered
  link_.end->performCommand(std::string(kCommandStatus), {}, forgetAfter, [this](const Reply& reply) {
    if (reply.status == 0) {
      takeSource(reply);
    } else {
      nextQuestion_ = Clock::now() + livePause;
    }
  });
}

void Manager::sendOperations() {
  std::deque<Operation> operations;
  {
    const std::lock_guard lock(mutex_);
    operations.swap(operations_);
    for (const Operation& operation : operations) {
      if (!operation.call) delivering_ = operation.on;
    }
    std::erase_if(operations, [](const Operation& operation) { return operation.call && operation.call->abandoned; });
  }
  for (const Operation& operation : operations) {
    if (!operation.call) {
      link_.end->setEvents(operation.on);
      continue;
    }
    const auto& call = operation.call;
    sent_.push_back(call);
    if (!link_.end->performCommand(call->command, call->request, forgetAfter, [this, call](Reply reply) {
          // Why the connection ended is told to all at once, by disconnect().
          if (reply.status != kStatusConnectionLost) finish(call, std::move(reply));
        })) {
      finish(call, {kStatusCannotEncode, "the request cannot be sent: it is too large or nested too deep", {}});
    }
  }
}

void Manager::finish(const std::shared_ptr<Call>& call, Reply reply) {
  std::erase(sent_, call);
  {
    const std::lock_guard lock(mutex_);
    call->reply = std::move(reply);
  }
  answered_.notify_all();
}

void Manager::disconnect(const std::string& problem) {
  link_ = {};
  waitsForName_ = false;
  scheduleAttempt();
  disconnectOperations(problem);
}

// Those who wait for an answer learn that none comes; what was asked of delivery is kept for the next connection.
void Manager::disconnectOperations(const std::string& problem) {
  {
    const std::lock_guard lock(mutex_);
    linked_ = false;
    status_.connected = false;
    status_.problem = problem;
    for (const Operation& operation : operations_) {
      if (operation.call) {
        sent_.push_back(operation.call);
      } else {
        delivering_ = operation.on;
      }
    }
    operations_.clear();
    for (const auto& call : sent_) {
      call->reply = Reply{kStatusConnectionLost, "the connection to the baseband manager was lost: " + problem, {}};
    }
  }
  sent_.clear();
  answered_.notify_all();
}

void Manager::waitForWork() {
  std::array<pollfd, 2> ready{};
  ready[0] = {wake_.descriptor(), POLLIN, 0};
  std::chrono::microseconds timeout{-1};
  nfds_t count = 1;
  if (link_.end && !heldBack()) {
    const vespscope::bus::Wait wait = link_.end->wait();
    timeout = wait.timeout;
    if (wait.descriptor >= 0) {
      ready[1] = {wait.descriptor, wait.events, 0};
      count = 2;
    }
  }
  if (link_.end && !waitsForName_ && nextQuestion_ != Clock::time_point::max()) {
    const auto pause = std::chrono::ceil<std::chrono::microseconds>(nextQuestion_ - Clock::now());
    timeout = std::max(timeout < 0us ? pause : std::min(timeout, pause), 0us);
  }
  if (!link_.end || waitsForName_) {
    const auto pause = std::chrono::duration_cast<std::chrono::microseconds>(nextAttempt_ - Clock::now());
    timeout = std::max(timeout < 0us ? pause : std::min(timeout, pause), 0us);
  }
  const bool endless = timeout < 0us;
  const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(timeout);
  const timespec limit{static_cast<time_t>(seconds.count()),
                       static_cast<long>(std::chrono::nanoseconds(timeout - seconds).count())};
  ::ppoll(ready.data(), count, endless ? nullptr : &limit, nullptr);
  wake_.clear();
}

void Manager::receive(std::string_view kind, std::uint64_t sequence, Dictionary event) {
  if (sequence > nextSequence_) lost_ += sequence - nextSequence_;
  nextSequence_ = sequence + 1;
  arrived_.push_back({std::string(kind), std::move(event)});
}

void Manager::handOverEvents() {
  if (arrived_.empty()) return;
  {
    const std::lock_guard lock(mutex_);
    status_.eventsLost += std::exchange(lost_, 0);
    status_.eventsReceived += arrived_.size();
    status_.lastEvent = std::chrono::system_clock::now();
  }
  if (!queue_) return arrived_.clear();
  inbox_->add(arrived_);
}

}  // namespace rhox::client
