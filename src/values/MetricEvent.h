// One metric event as it travels between a source, a capture file and the manager.
#pragma once

#include <chrono>
#include <cstdint>

#include "values/Value.h"

namespace vespscope {

struct MetricEvent {
  std::int32_t metricID = 0;  // full identifier, 0x3C0000 + tag
  std::int32_t profileID = 0;
  Bytes payload;                     // one message in the Protocol Buffers wire format
  std::chrono::nanoseconds time{0};  // since 1970-01-01 00:00 UTC: when the modem reported it
};

}  // namespace vespscope
