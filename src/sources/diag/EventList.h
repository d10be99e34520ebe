// The metric events of one log record, in order.
#pragma once

#include <chrono>
#include <cstdint>
#include <vector>

#include "messages/WireMessage.h"
#include "sources/report/StampedEvent.h"
#include "values/MetricEvent.h"

namespace vespscope::sources::diag {

// A cell that is not measured again for this long counts as lost.
inline constexpr std::chrono::nanoseconds measurementLifetime = std::chrono::seconds(3);

// Whether a measurement at `then` is still valid at `now`; after a jump of the clock earlier ones are not.
[[nodiscard]] inline bool stillCounts(std::chrono::nanoseconds then, std::chrono::nanoseconds now,
                                      std::chrono::nanoseconds lifetime = measurementLifetime) {
  return now - then <= lifetime && then - now <= lifetime;
}

class EventList {
 public:
  // Every event gets `profileID` and `time`.
  EventList(std::int32_t profileID, std::chrono::nanoseconds time) : profileID_(profileID), time_(time) {}

  [[nodiscard]] std::chrono::nanoseconds time() const { return time_; }

  // Adds `message` under the metric `metricID`, with the list's time as its timestamp in milliseconds.
  template <class Message>
  void add(std::int32_t metricID, Message& message) {
    events_.push_back(stampedEvent(metricID, message, time_, profileID_));
  }

  [[nodiscard]] const std::vector<MetricEvent>& events() const { return events_; }
  [[nodiscard]] std::vector<MetricEvent> take() { return std::move(events_); }

 private:
  std::int32_t profileID_;
  std::chrono::nanoseconds time_;
  std::vector<MetricEvent> events_;
};

}  // namespace vespscope::sources::diag
