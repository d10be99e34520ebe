// Makes a metric event of a message and the moment that it describes.
#pragma once

#include <chrono>
#include <cstdint>

#include "values/MetricEvent.h"

namespace vespscope::sources {

// Stamps `message` with `time`, since 1970-01-01 00:00 UTC, in whole milliseconds (rounded down), and returns it as an
// event of `metricID`.
template <class Message>
[[nodiscard]] MetricEvent stampedEvent(std::int32_t metricID, Message& message, std::chrono::nanoseconds time,
                                       std::int32_t profileID = 0) {
  message.setTimestamp(static_cast<std::uint64_t>(std::chrono::floor<std::chrono::milliseconds>(time).count()));
  return {metricID, profileID, message.encoded(), time};
}

}  // namespace vespscope::sources
