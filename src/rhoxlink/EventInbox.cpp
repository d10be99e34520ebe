#include "rhoxlink/EventInbox.h"

#include <utility>

namespace rhox::client {

void EventInbox::setHandler(std::string_view kind, EventHandler handler) {
  auto shared = std::make_shared<const EventHandler>(std::move(handler));
  const std::lock_guard lock(mutex_);
  handlers_.insert_or_assign(std::string(kind), std::move(shared));
}

bool EventInbox::add(std::string_view kind, vespscope::ipc::Dictionary event) {
  const std::lock_guard lock(mutex_);
  if (waiting_.size() >= capacity) {
    waiting_.pop_front();
    ++dropped_;
  }
  waiting_.push_back({std::string(kind), std::move(event)});
  return !std::exchange(draining_, true);
}

void EventInbox::drain() {
  std::unique_lock lock(mutex_);
  while (!waiting_.empty()) {
    Waiting next = std::move(waiting_.front());
    waiting_.pop_front();
    const auto found = handlers_.find(next.kind);
    const SharedHandler handler = found == handlers_.end() ? nullptr : found->second;
    lock.unlock();
    if (handler && *handler) (*handler)(vespscope::ipc::Object(std::move(next.event)), shared_from_this());
    lock.lock();
  }
  draining_ = false;
}

std::uint64_t EventInbox::dropped() const {
  const std::lock_guard lock(mutex_);
  return dropped_;
}

}  // namespace rhox::client
