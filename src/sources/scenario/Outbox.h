// Collects the metric events of one radio frame and stamps each with its own moment.
#pragma once

#include <chrono>
#include <cstdint>
#include <deque>
#include <optional>

#include "sources/report/StampedEvent.h"
#include "sources/scenario/Clock.h"
#include "sources/scenario/Random.h"
#include "values/MetricEvent.h"

namespace vespscope::sources::scenario {

class Outbox {
 public:
  // `start` is the moment at which the drive begins, since 1970-01-01 00:00 UTC.
  Outbox(std::uint64_t seed, std::chrono::nanoseconds start) : random_(hashOf(seed, 30)), start_(start) {}

  // Begins a new frame.
  void begin(Time now);

  // Stamps the message with the moment of its event and stores the event for delivery.
  template <class Message>
  void send(std::int32_t metricID, Message& message) {
    events_.push_back(stampedEvent(metricID, message, nextMoment()));
  }

  [[nodiscard]] std::optional<MetricEvent> take();

 private:
  std::chrono::nanoseconds nextMoment();

  Random random_;
  std::chrono::nanoseconds start_;
  std::chrono::nanoseconds frameBegin_{0};
  std::chrono::nanoseconds offset_{0};  // of the latest event within the frame
  std::deque<MetricEvent> events_;
};

}  // namespace vespscope::sources::scenario
