#include "manager/recording/Recorder.h"

#include <pthread.h>

#include <algorithm>
#include <utility>

#include "platform/log/Log.h"

namespace vespscope::manager {
namespace {

constexpr std::size_t batchSize = 512;  // events written at once

}  // namespace

Recorder::Recorder(std::unique_ptr<RecordingTarget> target, const Options& options)
    : target_(std::move(target)), options_(options), waiting_(options.bounds), thread_([this] { run(); }) {
  ::pthread_setname_np(thread_.native_handle(), "recorder");
}

Recorder::~Recorder() {
  {
    const std::lock_guard lock(mutex_);
    stopping_ = true;
  }
  changed_.notify_all();
  thread_.join();
}

void Recorder::record(SharedEvent event) {
  bool wasEmpty = false;
  {
    const std::lock_guard lock(mutex_);
    wasEmpty = waiting_.empty();
    waiting_.push(std::move(event));
  }
  if (wasEmpty) changed_.notify_all();
}

RecordingStatus Recorder::status() const {
  const std::lock_guard lock(mutex_);
  RecordingStatus status = status_;
  status.lost += waiting_.lost();
  return status;
}

void Recorder::run() {
  while (takeWaiting()) {
    if (writeTaken()) continue;
    std::unique_lock lock(mutex_);
    if (changed_.wait_for(lock, options_.pause, [this] { return stopping_; })) return;
  }
}

// Waits for events; returns false when there are none and no more can come.
bool Recorder::takeWaiting() {
  std::unique_lock lock(mutex_);
  if (taken_.empty()) changed_.wait(lock, [this] { return stopping_ || !waiting_.empty(); });
  while (taken_.size() < batchSize) {
    auto next = waiting_.take();
    if (!next) break;
    taken_.push_back(std::move(next->event));
  }
  return !taken_.empty();
}

// Returns false when some events must be tried again.
bool Recorder::writeTaken() {
  const RecordingOutcome outcome = target_->write(taken_);
  taken_.erase(taken_.begin(), taken_.begin() + static_cast<std::ptrdiff_t>(outcome.taken));
  std::string said;
  {
    const std::lock_guard lock(mutex_);
    status_.recorded += outcome.taken - outcome.refused;
    status_.recorded -= std::min(outcome.removed, status_.recorded);
    status_.lost += outcome.refused + outcome.removed;
    const std::uint64_t lost = status_.lost + waiting_.lost();
    if (outcome.problem && status_.problem.empty()) {
      lostBefore_ = lost;
      said = "nothing is recorded: " + *outcome.problem;
    } else if (!outcome.problem && !status_.problem.empty()) {
      said = "recording continues; " + std::to_string(lost - lostBefore_) + " events were lost meanwhile";
    }
    status_.problem = outcome.problem.value_or("");
  }
  if (!said.empty()) log::system(said);
  return !outcome.problem;
}

}  // namespace vespscope::manager
