// Metric events as they arrive from the manager.
#pragma once

#include <chrono>
#include <optional>

#include "platform/ipc/IpcObject.h"
#include "values/MetricEvent.h"

namespace rhox::client {

// The event that a handler or observer of kEventMetric is given, with `time` as its time; empty when an entry is
// missing or has another form. Without a profile it is profile 0's.
[[nodiscard]] std::optional<vespscope::MetricEvent> metricEventOf(const vespscope::ipc::Object& event,
                                                                  std::chrono::nanoseconds time);

}  // namespace rhox::client
