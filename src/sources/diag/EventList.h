// The metric events of one log record, in order.
#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
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

// When a state was reported, so that messages that confirm it report it again with a newer time, but not each of them.
class ReportedAt {
 public:
  // A table of metrics is read about this often.
  static constexpr std::chrono::nanoseconds pause = std::chrono::seconds(5);

  void note(std::chrono::nanoseconds time) { time_ = time; }
  // Whether a confirmation at `now` is to be reported; never of what was not reported.
  [[nodiscard]] bool isOld(std::chrono::nanoseconds now) const { return time_ && now - *time_ >= pause; }

 private:
  std::optional<std::chrono::nanoseconds> time_;
};

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
