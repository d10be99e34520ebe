#include "rhoxlink/EventInbox.h"

#include <utility>

#include "platform/dispatch/MainLoop.h"
#include "platform/dispatch/SerialQueue.h"

namespace rhox::client {
namespace {

constexpr std::size_t takenAtOnce = 64;  // events

}  // namespace

EventInbox::EventInbox(std::weak_ptr<vespscope::dispatch::SerialQueue> queue, Afterwards afterwards)
    : queue_(std::move(queue)), afterwards_(std::move(afterwards)) {}

void EventInbox::setHandler(std::string_view kind, EventHandler handler) {
  setReceiver(kind, [&handler](Receivers& receivers) { receivers.handler = std::move(handler); });
}

void EventInbox::setObserver(std::string_view kind, EventObserver observer) {
  setReceiver(kind, [&observer](Receivers& receivers) { receivers.observer = std::move(observer); });
}

void EventInbox::setReceiver(std::string_view kind, const std::function<void(Receivers&)>& change) {
  const std::lock_guard lock(mutex_);
  Handlers handlers = *handlers_;
  std::shared_ptr<const Receivers>& place = handlers[std::string(kind)];
  Receivers receivers = place ? *place : Receivers{};
  change(receivers);
  place = std::make_shared<const Receivers>(std::move(receivers));
  handlers_ = std::make_shared<const Handlers>(std::move(handlers));
  ++handlerChanges_;
}

void EventInbox::setRoomHandler(std::function<void()> onRoom) {
  const std::lock_guard lock(mutex_);
  onRoom_ = std::move(onRoom);
}

void EventInbox::add(std::vector<Arrived>& arrived) {
  if (arrived.empty()) return;
  {
    const std::lock_guard lock(mutex_);
    for (Arrived& next : arrived) {
      waitingBytes_ += next.size;
      waiting_.push_back(std::move(next));
      while (waiting_.size() > capacity || (waitingBytes_ > byteCapacity && waiting_.size() > 1)) {
        removeFirst();
        ++dropped_;
      }
    }
    arrived.clear();
    if (waiting_.size() >= capacity / 2 || waitingBytes_ >= byteCapacity / 2) crowded_ = true;
    if (draining_ || !windowTakes({})) return;
    draining_ = true;
  }
  scheduleDrain();
}

void EventInbox::removeFirst() {
  waitingBytes_ -= waiting_.front().size;
  waiting_.pop_front();
}

void EventInbox::scheduleDrain() {
  if (const auto queue = queue_.lock()) queue->async([inbox = shared_from_this()] { inbox->drain(); });
}

bool EventInbox::windowTakes(const Amount& more) const {
  return underWay_.events + more.events < windowEvents && underWay_.bytes + more.bytes < windowBytes;
}

bool EventInbox::take(std::vector<Arrived>& taken, Amount& amount) {
  taken.clear();
  amount = {};
  const std::lock_guard lock(mutex_);
  while (!waiting_.empty() && amount.events < takenAtOnce && windowTakes(amount)) {
    ++amount.events;
    amount.bytes += waiting_.front().size;
    taken.push_back(std::move(waiting_.front()));
    removeFirst();
  }
  if (crowded_ && waiting_.size() < capacity / 4 && waitingBytes_ < byteCapacity / 4) {
    crowded_ = false;
    if (onRoom_) onRoom_();
  }
  if (taken.empty()) draining_ = false;
  return !taken.empty();
}

void EventInbox::drain() {
  std::vector<Arrived> taken;
  Amount amount;
  std::shared_ptr<const Handlers> handlers;
  std::optional<std::uint64_t> known;  // the version of `handlers`
  while (take(taken, amount)) {
    {
      // Collects what the handlers submit to the main queue.
      const vespscope::dispatch::TaskBatch batch(vespscope::dispatch::MainLoop::main());
      for (Arrived& next : taken) {
        if (known != handlerChanges_) {
          const std::lock_guard lock(mutex_);
          handlers = handlers_;
          known = handlerChanges_;
        }
        const auto found = handlers->find(next.kind);
        if (found == handlers->end()) continue;
        const vespscope::ipc::Object event(std::move(next.event));
        if (found->second->observer) found->second->observer(event, next.facts);
        if (found->second->handler) found->second->handler(event, shared_from_this());
      }
    }
    if (!afterwards_) continue;
    std::unique_lock lock(mutex_);
    underWay_.events += amount.events;
    underWay_.bytes += amount.bytes;
    mark(lock);
  }
}

void EventInbox::mark(std::unique_lock<std::mutex>& lock) {
  if (marked_ || (underWay_.events < markEvery && underWay_.bytes < markEveryBytes)) return;
  marked_ = true;
  const Amount before = underWay_;
  lock.unlock();
  afterwards_([inbox = shared_from_this(), before] { inbox->passed(before); });
  lock.lock();
}

void EventInbox::passed(const Amount& before) {
  std::unique_lock lock(mutex_);
  underWay_.events -= before.events;
  underWay_.bytes -= before.bytes;
  marked_ = false;
  mark(lock);
  if (draining_ || waiting_.empty() || !windowTakes({})) return;
  draining_ = true;
  lock.unlock();
  scheduleDrain();
}

std::uint64_t EventInbox::dropped() const {
  const std::lock_guard lock(mutex_);
  return dropped_;
}

}  // namespace rhox::client
