#include "manager/ConfigurationKeeper.h"

#include <pthread.h>

namespace vespscope::manager {

ConfigurationKeeper::ConfigurationKeeper(Write write, std::function<void()> doneWait)
    : write_(std::move(write)), doneWait_(std::move(doneWait)), thread_([this] { run(); }) {
  ::pthread_setname_np(thread_.native_handle(), "keeper");
}

ConfigurationKeeper::~ConfigurationKeeper() {
  {
    const std::lock_guard lock(mutex_);
    stopping_ = true;
  }
  changed_.notify_all();
  thread_.join();
}

void ConfigurationKeeper::keep(std::int64_t application, std::optional<Bytes> configuration, Done done) {
  {
    const std::lock_guard lock(mutex_);
    if (!waiting_.contains(application)) order_.push_back(application);
    Waiting& waiting = waiting_[application];
    waiting.configuration = std::move(configuration);
    waiting.done.push_back(std::move(done));
  }
  changed_.notify_all();
}

void ConfigurationKeeper::callDone() {
  std::vector<std::pair<Done, Problem>> done;
  {
    const std::lock_guard lock(mutex_);
    done.swap(done_);
  }
  for (const auto& [call, problem] : done) call(problem);
}

void ConfigurationKeeper::run() {
  std::unique_lock lock(mutex_);
  while (true) {
    changed_.wait(lock, [this] { return stopping_ || !order_.empty(); });
    if (order_.empty()) return;
    auto next = waiting_.extract(order_.front());
    order_.pop_front();
    lock.unlock();
    const Problem problem = write_(next.key(), next.mapped().configuration);
    lock.lock();
    for (Done& done : next.mapped().done) done_.emplace_back(std::move(done), problem);
    if (!stopping_) doneWait_();
  }
}

}  // namespace vespscope::manager
