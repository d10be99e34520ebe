#include "platform/dispatch/SerialQueue.h"

#include <pthread.h>

#include <future>
#include <utility>

namespace vespscope::dispatch {

SerialQueue::SerialQueue(std::string label) : label_(std::move(label)), thread_([this] { run(); }) {
  // The kernel keeps 15 characters of a thread's name, and the label's end says more than its start.
  const std::string name = label_.size() > 15 ? label_.substr(label_.size() - 15) : label_;
  ::pthread_setname_np(thread_.native_handle(), name.c_str());
}

SerialQueue::~SerialQueue() {
  {
    const std::lock_guard lock(mutex_);
    stopping_ = true;
  }
  changed_.notify_one();
  thread_.join();
}

void SerialQueue::async(std::function<void()> task) {
  {
    const std::lock_guard lock(mutex_);
    tasks_.push_back(std::move(task));
  }
  changed_.notify_one();
}

void SerialQueue::drain() {
  std::promise<void> reached;
  async([&reached] { reached.set_value(); });
  reached.get_future().wait();
}

std::size_t SerialQueue::size() const {
  const std::lock_guard lock(mutex_);
  return tasks_.size();
}

void SerialQueue::run() {
  std::unique_lock lock(mutex_);
  while (true) {
    changed_.wait(lock, [this] { return stopping_ || !tasks_.empty(); });
    if (tasks_.empty()) return;
    std::function<void()> task = std::move(tasks_.front());
    tasks_.pop_front();
    lock.unlock();
    task();
    task = nullptr;
    lock.lock();
  }
}

}  // namespace vespscope::dispatch
