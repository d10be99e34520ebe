#include "sources/scenario/Outbox.h"

#include <algorithm>

namespace vespscope::sources::scenario {

void Outbox::begin(Time now) {
  frameBegin_ = start_ + now;
  offset_ = std::chrono::nanoseconds(0);
}

// Reports are a fraction of a millisecond apart, all within their frame.
std::chrono::nanoseconds Outbox::nextMoment() {
  constexpr std::chrono::nanoseconds last = std::chrono::nanoseconds(frame) - std::chrono::microseconds(1);
  offset_ = std::min(offset_ + std::chrono::microseconds(random_.between(40, 600)), last);
  return frameBegin_ + offset_;
}

std::optional<MetricEvent> Outbox::take() {
  if (events_.empty()) return std::nullopt;
  MetricEvent event = std::move(events_.front());
  events_.pop_front();
  return event;
}

}  // namespace vespscope::sources::scenario
