#include "rhoxlink/bus/Waiting.h"

#include <algorithm>

namespace vespscope::bus {

using std::chrono::nanoseconds;

void Waiting::add(int descriptor, short events) {
  if (descriptor >= 0) ready_.push_back({descriptor, events, 0});
}

void Waiting::add(const Wait& wait) {
  add(wait.descriptor, wait.events);
  add(wait.outputDescriptor, wait.outputEvents);
  if (wait.timeout.count() >= 0) atMost(wait.timeout);
}

void Waiting::atMost(nanoseconds limit) { limit_ = std::max(std::min(limit_.value_or(limit), limit), nanoseconds(0)); }

void Waiting::wait() {
  timespec limit{};
  if (limit_) {
    const auto seconds = std::chrono::duration_cast<std::chrono::seconds>(*limit_);
    limit.tv_sec = static_cast<time_t>(seconds.count());
    limit.tv_nsec = static_cast<long>((*limit_ - seconds).count());
  }
  ::ppoll(ready_.data(), ready_.size(), limit_ ? &limit : nullptr, nullptr);
}

}  // namespace vespscope::bus
