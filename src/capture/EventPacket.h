// A metric event as the bytes of one capture packet, and back. The file stores the packet's time separately.
#pragma once

#include <cstdint>
#include <span>

#include "values/MetricEvent.h"
#include "values/Result.h"

namespace vespscope::capture {

[[nodiscard]] Bytes packetOf(const MetricEvent& event);

// Fails when the bytes are not a MetricEvent or have no metric_id.
[[nodiscard]] Result<MetricEvent> eventOf(std::span<const std::uint8_t> packet, std::chrono::nanoseconds time);

}  // namespace vespscope::capture
