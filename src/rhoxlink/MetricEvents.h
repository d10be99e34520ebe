// Metric events as they arrive from the manager.
#pragma once

#include <chrono>
#include <optional>

#include "platform/ipc/IpcObject.h"
#include "values/MetricEvent.h"

namespace rhox::client {

// Makes a metric event of the entries given to a handler or observer of kEventMetric, with `time` as its time; empty
// when an entry is missing or has another type. Without a profile entry the profile is 0.
[[nodiscard]] std::optional<vespscope::MetricEvent> metricEventOf(const vespscope::ipc::Object& event,
                                                                  std::chrono::nanoseconds time);

}  // namespace rhox::client
