// A part of a simulated drive, decoded, for tests.
#pragma once

#include <chrono>
#include <cstdint>
#include <memory>
#include <set>
#include <string_view>
#include <vector>

#include "messages/WireMessage.h"
#include "values/MetricEvent.h"

namespace vespscope::test {

inline constexpr std::chrono::nanoseconds driveStart = std::chrono::seconds(1'700'000'000);

// The events of the first `length` of the drive with `seed`.
[[nodiscard]] std::vector<MetricEvent> driveOf(std::uint64_t seed, std::chrono::milliseconds length);

// Time since the drive began.
[[nodiscard]] std::chrono::milliseconds sinceStart(const MetricEvent& event);

// The event's payload as a message of its metric's class; null if it cannot be read.
[[nodiscard]] std::shared_ptr<WireMessage> decoded(const MetricEvent& event);

// The event's payload as the requested message class; empty for an event of another metric.
template <class Message>
[[nodiscard]] std::shared_ptr<Message> as(const MetricEvent& event) {
  return std::dynamic_pointer_cast<Message>(decoded(event));
}

// The name of the event's metric, "K_LTE_RRC_STATE".
[[nodiscard]] std::string_view metricName(const MetricEvent& event);

[[nodiscard]] std::set<std::string_view> metricNames(const std::vector<MetricEvent>& events);

}  // namespace vespscope::test
