#include "sources/playback/Playback.h"

#include <algorithm>

namespace vespscope::sources {

std::optional<std::chrono::nanoseconds> Playback::schedule(std::chrono::nanoseconds time) {
  using std::chrono::nanoseconds;
  if (lastTime_) {
    const bool backwards = time < *lastTime_;
    const nanoseconds gap = backwards ? nanoseconds(0) : time - *lastTime_;
    if (options_.realGaps) {
      position_ += gap;
    } else {
      position_ += backwards ? nanoseconds(longestGap) : std::min<nanoseconds>(gap, longestGap);
    }
  }
  lastTime_ = time;
  if (position_ < options_.start) return std::nullopt;
  if (options_.speed == PlaybackOptions::maximum) return nanoseconds(0);
  const auto total = static_cast<double>((played_ + position_ - options_.start).count());
  return nanoseconds(static_cast<nanoseconds::rep>(total / options_.speed));
}

void Playback::restart() {
  played_ += std::max(position_ - options_.start, std::chrono::nanoseconds(0)) + loopGap;
  position_ = std::chrono::nanoseconds(0);
  lastTime_.reset();
}

}  // namespace vespscope::sources
