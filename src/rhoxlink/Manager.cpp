#include "rhoxlink/Manager.h"

#include <pthread.h>

#include <algorithm>
#include <optional>
#include <utility>

#include "platform/dispatch/SerialQueue.h"
#include "rhoxlink/Connector.h"
#include "rhoxlink/StatusReply.h"
#include "rhoxlink/bus/Waiting.h"

namespace rhox::client {
namespace {

using namespace std::chrono_literals;
using vespscope::bus::Reply;
using vespscope::ipc::Dictionary;
using vespscope::ipc::Object;

constexpr std::chrono::milliseconds firstBackoff = 100ms;
constexpr std::chrono::milliseconds longestBackoff = 1s;
// An attempt that starts a program, on this machine or another, is made less often.
constexpr std::chrono::milliseconds longestCostlyBackoff = 15s;
// The maximum wait for the first answer when a manager must be started or a machine reached.
constexpr auto startPatience = 15s;
// The interval between status requests while the status changes without commands: a live source's label contains the
// modem's state, and a recording's status its position.
constexpr auto questionPause = 1s;
// The maximum wait for an answer whose caller has timed out; until then the connection keeps the call.
constexpr auto forgetAfter = 1min;

// The maximum number of messages read before their events are passed on together.
constexpr int turn = 64;
constexpr std::size_t turnBytes = std::size_t{1} << 20;  // same, in bytes of their content

}  // namespace

Manager::Manager(std::string name, vespscope::Result<Address> address, vespscope::bus::EmbeddedFactory factory,
                 std::shared_ptr<vespscope::dispatch::SerialQueue> queue, Afterwards afterwards)
    : name_(std::move(name)),
      address_(std::move(address)),
      factory_(std::move(factory)),
      queue_(std::move(queue)),
      inbox_(std::make_shared<EventInbox>(queue_, std::move(afterwards))),
      commands_([this] { wake_.wake(); }, takesItsTime() ? startPatience : 0s),
      backoff_(firstBackoff) {
  inbox_->setRoomHandler([this] { wake_.wake(); });
  connect();
  thread_ = std::thread([this] { run(); });
  ::pthread_setname_np(thread_.native_handle(), "rhoxlink");
}

Manager::~Manager() {
  stopping_ = true;
  wake_.wake();
  thread_.join();
  inbox_->setRoomHandler(nullptr);
  link_ = {};
}

Result Manager::perform(std::string_view command, const Dictionary& request, Object& reply,
                        std::chrono::milliseconds timeout) {
  {
    const std::lock_guard lock(mutex_);
    subscription_.sending(request);
  }
  Result result = commands_.perform(command, request, reply, timeout);
  if (result.status == kStatusNotConnected) {
    const std::lock_guard lock(mutex_);
    subscription_.answered(command, request, {result.status, result.message, {}});
  }
  return result;
}

void Manager::setObserver(std::string_view event, EventObserver observer) {
  inbox_->setObserver(event, std::move(observer));
  commands_.askForTimes();
}

ConnectionStatus Manager::status() const {
  const bool delivering = commands_.delivering();
  const std::lock_guard lock(mutex_);
  ConnectionStatus status = status_;
  status.notSubscribed = subscription_.problem();
  if (status.notSubscribed.empty() && !delivering) status.notSubscribed = "delivery of events is off";
  status.eventsLost += inbox_->dropped();
  return status;
}

void Manager::run() {
  while (!stopping_) {
    if ((!link_.end || waitsForName_) && Clock::now() >= nextAttempt_) connect();
    if (link_.end && !waitsForName_) {
      sendOperations();
      askForStatus();
    }
    if (link_.end && !heldBack() && !work()) {
      if (waitsForName_) backoff_ = firstBackoff;  // the name has an owner now
      disconnect(whyEnded());
    }
    if (!refusal_.empty()) waitForName();
    waitForWork();
  }
}

// Reports when a manager is started by hand, so the bus is seldom asked to start one.
void Manager::waitForName() {
  const std::string problem = std::exchange(refusal_, {});
  if (!link_.end) return;
  waitsForName_ = true;
  scheduleAttempt();
  close(problem);
}

void Manager::scheduleAttempt() {
  nextAttempt_ = Clock::now() + backoff_;
  backoff_ = std::min(backoff_ * 2, takesItsTime() ? longestCostlyBackoff : longestBackoff);
}

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
  giveConfigurations();
  if (commands_.delivering()) link_.end->setEvents(true);
  commands_.opened();
}

void Manager::sayHello() {
  Dictionary request;
  {
    const std::lock_guard lock(mutex_);
    if (const auto application = subscription_.application()) request.set(kKeyAppID, Object(*application));
  }
  request.set(kKeyClientName, Object(name_));
  request.set(kKeyProtocol, Object(kProtocol));
  if (commands_.wantsTimes()) request.set(kKeyEventTimes, Object(true));
  // No timeout: no caller waits for this answer, and it proves that the connection works.
  link_.end->performCommand(std::string(kCommandStatus), request, 24h,
                            [this](const Reply& reply) { learnSource(reply); });
}

void Manager::giveConfigurations() {
  std::vector<Dictionary> requests;
  {
    const std::lock_guard lock(mutex_);
    requests = subscription_.begin();
  }
  for (const Dictionary& request : requests) {
    link_.end->performCommand(std::string(kCommandAddConfiguration), request, 24h, [this](const Reply& reply) {
      const std::lock_guard lock(mutex_);
      subscription_.givenAgain(reply);
    });
  }
}

void Manager::learnSource(const Reply& reply) {
  if (reply.status == kStatusConnectionLost || reply.status == kStatusTimedOut) return;
  if (reply.status == kStatusNoManager || reply.status == kStatusAccessDenied || reply.status == kStatusNoPlace) {
    refusal_ = reply.message;
    return;
  }
  backoff_ = firstBackoff;
  takeStatus(reply);
  {
    const std::lock_guard lock(mutex_);
    status_.connected = true;
    status_.problem.clear();
    ++status_.connections;
  }
  commands_.answered();
}

void Manager::takeStatus(const Reply& reply) {
  const Object* configured = reply.values.find(kKeyConfigured);
  const std::lock_guard lock(mutex_);
  client::takeStatus(reply.values, status_);
  if (configured != nullptr && configured->asBool() != nullptr) subscription_.reported(*configured->asBool());
  if (changesByItself(status_)) nextQuestion_ = Clock::now() + questionPause;
}

void Manager::askForStatus() {
  if (Clock::now() < nextQuestion_) return;
  nextQuestion_ = Clock::time_point::max();  // until the answer arrives
  link_.end->performCommand(std::string(kCommandStatus), {}, forgetAfter, [this](const Reply& reply) {
    if (reply.status == 0) {
      takeStatus(reply);
    } else {
      nextQuestion_ = Clock::now() + questionPause;
    }
  });
}

void Manager::sendOperations() {
  for (const Commands::Operation& operation : commands_.take()) send(operation);
}

void Manager::send(const Commands::Operation& operation) {
  using Kind = Commands::Operation::Kind;
  if (operation.kind == Kind::eventsOn || operation.kind == Kind::eventsOff) {
    link_.end->setEvents(operation.kind == Kind::eventsOn);
    return;
  }
  if (operation.kind == Kind::askForTimes) {
    Dictionary request;
    request.set(kKeyProtocol, Object(kProtocol));
    request.set(kKeyEventTimes, Object(true));
    link_.end->performCommand(std::string(kCommandStatus), request, forgetAfter, [](const Reply&) {});
    return;
  }
  const auto& call = operation.call;
  const auto finish = [this, call](Reply reply) {
    {
      const std::lock_guard lock(mutex_);
      subscription_.answered(call->command, call->request, reply);
    }
    commands_.finish(call, std::move(reply));
  };
  commands_.sent(call);
  if (!link_.end->performCommand(call->command, call->request, forgetAfter, [finish](Reply reply) {
        // close() reports to all callers at once why the connection ended.
        if (reply.status != kStatusConnectionLost) finish(std::move(reply));
      })) {
    finish({kStatusCannotEncode, "the request cannot be sent: it is too large or nested too deep", {}});
  }
}

void Manager::disconnect(const std::string& problem) {
  link_ = {};
  waitsForName_ = false;
  scheduleAttempt();
  close(problem);
}

void Manager::close(const std::string& problem) {
  {
    const std::lock_guard lock(mutex_);
    status_.connected = false;
    status_.problem = problem;
  }
  commands_.closed(problem);
}

void Manager::waitForWork() {
  vespscope::bus::Waiting waiting;
  waiting.add(wake_.descriptor(), POLLIN);
  if (link_.end && !heldBack()) waiting.add(link_.end->wait());
  const bool attempts = !link_.end || waitsForName_;
  if (attempts) {
    waiting.until(nextAttempt_);
  } else if (nextQuestion_ != Clock::time_point::max()) {
    waiting.until(nextQuestion_);
  }
  waiting.wait();
  wake_.clear();
}

void Manager::receive(std::string_view kind, std::uint64_t sequence, Dictionary event) {
  if (sequence > nextSequence_) lost_ += sequence - nextSequence_;
  nextSequence_ = sequence + 1;
  EventFacts facts;
  if (const std::optional<Object> time = event.take(kKeyTime); time && time->asInt64() != nullptr) {
    facts.time = std::chrono::nanoseconds(*time->asInt64());
  }
  const std::size_t size = vespscope::ipc::contentSize(event);
  // Our sources make no event of this size, and decoding it would take many times its size in memory.
  if (size > EventInbox::eventLimit) {
    ++lost_;
    return;
  }
  arrived_.push_back({std::string(kind), std::move(event), facts, size});
  arrivedBytes_ += size;
  if (arrivedBytes_ > turnBytes) handOverEvents();
}

void Manager::handOverEvents() {
  if (arrived_.empty() && lost_ == 0) return;
  {
    const std::lock_guard lock(mutex_);
    status_.eventsLost += std::exchange(lost_, 0);
    status_.eventsReceived += arrived_.size();
    if (!arrived_.empty()) status_.lastEvent = std::chrono::system_clock::now();
  }
  arrivedBytes_ = 0;
  if (!queue_) return arrived_.clear();
  inbox_->add(arrived_);
}

}  // namespace rhox::client
