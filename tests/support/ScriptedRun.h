// A short run of metric events with fixed contents: each handled metric once, one second apart.
#pragma once

#include <cstdint>
#include <vector>

#include "values/MetricEvent.h"
#include "values/Value.h"

namespace vespscope::test {

// 2023-11-14 22:13:20 UTC: the time of the run's first event.
inline constexpr std::uint64_t scriptedRunStart = 1'700'000'000'000;  // milliseconds since 1970

// The 29 metrics that the decoder handles, in the order LTE, mobility and SIM, UMTS, GSM.
[[nodiscard]] std::vector<MetricEvent> scriptedRun();

// The dictionary in which an event reaches the decoder.
[[nodiscard]] Record eventDictionary(const MetricEvent& event);

}  // namespace vespscope::test
