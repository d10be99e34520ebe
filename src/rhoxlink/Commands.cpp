#include "rhoxlink/Commands.h"

#include <algorithm>
#include <utility>

#include "platform/dispatch/SignalWatch.h"
#include "rhoxlink/bus/Names.h"

namespace rhox::client {
namespace {

using namespace std::chrono_literals;
using vespscope::dispatch::endWasRequested;

// How long a caller still waits once a signal has asked the program to end, and how often that is looked at.
constexpr auto endPatience = 300ms;
constexpr auto lookEvery = 50ms;

}  // namespace

using vespscope::bus::Reply;
using vespscope::ipc::Dictionary;
using vespscope::ipc::Object;

Result Commands::perform(std::string_view command, const Dictionary& request, Object& reply,
                         std::chrono::milliseconds timeout) {
  const auto call = std::make_shared<Call>();
  call->command = command;
  call->request = request;
  const Clock::time_point begin = Clock::now();
  call->deadline = begin + timeout;
  std::unique_lock lock(mutex_);
  if (!open_) return {kStatusNotConnected, "not connected to a baseband manager: " + problem_};
  operations_.push_back({Operation::Kind::call, call});
  lock.unlock();
  wake_();
  lock.lock();
  const auto replied = [&call] { return call->reply.has_value(); };
  while (!waitFor(lock, call->deadline, replied)) {
    if (!answered_ && Clock::now() < begin + startPatience_ && !endWasRequested()) {
      // The timeout counts from the manager's first answer.
      waitFor(lock, begin + startPatience_, [this, &replied] { return replied() || answered_; });
      call->deadline = Clock::now() + timeout;
      continue;
    }
    call->abandoned = true;
    if (endWasRequested()) return {kStatusTimedOut, "the program ends before the baseband manager answers"};
    return {kStatusTimedOut, "the baseband manager did not answer within " + std::to_string(timeout.count()) + " ms"};
  }
  reply = Object(std::move(call->reply->values));
  return {call->reply->status, std::move(call->reply->message)};
}

bool Commands::waitFor(std::unique_lock<std::mutex>& lock, Clock::time_point until,
                       const std::function<bool()>& condition) {
  std::optional<Clock::time_point> end;
  while (!condition()) {
    const Clock::time_point now = Clock::now();
    if (!end && endWasRequested()) end = now + endPatience;
    const Clock::time_point limit = end ? std::min(until, *end) : until;
    if (now >= limit) return false;
    changed_.wait_until(lock, std::min(limit, now + lookEvery));
  }
  return true;
}

void Commands::post(Operation operation) {
  {
    const std::lock_guard lock(mutex_);
    if (operation.kind == Operation::Kind::askForTimes) wantsTimes_ = true;
    if (open_) {
      operations_.push_back(std::move(operation));
    } else if (operation.kind != Operation::Kind::askForTimes) {
      delivering_ = operation.kind == Operation::Kind::eventsOn;  // the next connection starts with this setting
    }
  }
  wake_();
}

void Commands::setEvents(bool on) { post({on ? Operation::Kind::eventsOn : Operation::Kind::eventsOff, nullptr}); }

void Commands::askForTimes() { post({Operation::Kind::askForTimes, nullptr}); }

bool Commands::delivering() const {
  const std::lock_guard lock(mutex_);
  return delivering_;
}

bool Commands::wantsTimes() const {
  const std::lock_guard lock(mutex_);
  return wantsTimes_;
}

std::deque<Commands::Operation> Commands::take() {
  const std::lock_guard lock(mutex_);
  std::deque<Operation> operations = std::exchange(operations_, {});
  for (const Operation& operation : operations) {
    if (operation.kind == Operation::Kind::eventsOn) delivering_ = true;
    if (operation.kind == Operation::Kind::eventsOff) delivering_ = false;
  }
  std::erase_if(operations, [](const Operation& operation) { return operation.call && operation.call->abandoned; });
  return operations;
}

void Commands::finish(const std::shared_ptr<Call>& call, Reply reply) {
  std::erase(sent_, call);
  {
    const std::lock_guard lock(mutex_);
    call->reply = std::move(reply);
  }
  changed_.notify_all();
}

void Commands::opened() {
  const std::lock_guard lock(mutex_);
  open_ = true;
}

void Commands::answered() {
  {
    const std::lock_guard lock(mutex_);
    answered_ = true;
  }
  changed_.notify_all();
}

void Commands::closed(const std::string& problem) {
  {
    const std::lock_guard lock(mutex_);
    open_ = false;
    answered_ = false;
    problem_ = problem;
    for (const Operation& operation : std::exchange(operations_, {})) {
      if (operation.kind == Operation::Kind::call) {
        sent_.push_back(operation.call);
      } else if (operation.kind != Operation::Kind::askForTimes) {
        delivering_ = operation.kind == Operation::Kind::eventsOn;
      }
    }
    for (const auto& call : sent_) {
      call->reply = Reply{kStatusConnectionLost, "the connection to the baseband manager was lost: " + problem, {}};
    }
  }
  sent_.clear();
  changed_.notify_all();
}

}  // namespace rhox::client
