#include "sources/playback/PlayerClock.h"

namespace vespscope::sources {

bool SteadyPlayerClock::waitUntil(std::chrono::nanoseconds moment) {
  using Duration = std::chrono::steady_clock::duration;
  std::unique_lock lock(mutex_);
  const auto until = begin_ + std::chrono::duration_cast<Duration>(moment);
  const auto now = std::chrono::steady_clock::now();
  if (until - now > tolerance) {
    changed_.wait_until(lock, until, [this] { return interrupted_; });
  } else {
    begin_ += std::chrono::duration_cast<Duration>(notMadeUpFor(now - until));
  }
  return !interrupted_;
}

void SteadyPlayerClock::interrupt() {
  {
    const std::lock_guard lock(mutex_);
    interrupted_ = true;
  }
  changed_.notify_all();
}

}  // namespace vespscope::sources
