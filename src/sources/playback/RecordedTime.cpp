#include "sources/playback/RecordedTime.h"

#include "sources/playback/Source.h"

namespace vespscope::sources {

using std::chrono::nanoseconds;

nanoseconds saturatingSum(nanoseconds one, nanoseconds other) {
  nanoseconds::rep sum = 0;
  if (!__builtin_add_overflow(one.count(), other.count(), &sum)) return nanoseconds(sum);
  return other.count() < 0 ? nanoseconds::min() : nanoseconds::max();
}

nanoseconds saturatingDifference(nanoseconds from, nanoseconds subtracted) {
  nanoseconds::rep difference = 0;
  if (!__builtin_sub_overflow(from.count(), subtracted.count(), &difference)) return nanoseconds(difference);
  return subtracted.count() < 0 ? nanoseconds::max() : nanoseconds::min();
}

RecordedTime::Step RecordedTime::advance(nanoseconds time) {
  Step step;
  if (lastTime_) {
    step.backwards = time < *lastTime_;
    if (!step.backwards) step.length = saturatingDifference(time, *lastTime_);
  }
  lastTime_ = time;
  position_ = saturatingSum(position_, step.length);
  return step;
}

std::optional<nanoseconds> lengthOf(EventStream& stream, const std::stop_token& stop) {
  RecordedTime time;
  while (!stop.stop_requested()) {
    const std::optional<MetricEvent> event = stream.next();
    if (!event && stop.stop_requested()) break;
    if (!event) return time.position();
    time.advance(event->time);
  }
  return std::nullopt;
}

}  // namespace vespscope::sources
