// A metric event as the bytes of one capture packet, and back. The packet's time is kept beside it, by the file.
#pragma once

#include <cstdint>
#include <span>

#include "values/MetricEvent.h"
#include "values/Result.h"

namespace vespscope::capture {

[[nodiscard]] Bytes packetOf(const MetricEvent& event);

// Fails when the bytes are no MetricEvent or carry no metric_id.
[[nodiscard]] Result<MetricEvent> eventOf(std::span<const std::uint8_t> packet, std::chrono::nanoseconds time);

}  // namespace vespscope::capture
