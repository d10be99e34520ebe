// The simulated drive as a source of metric events.
#pragma once

#include <chrono>
#include <cstdint>
#include <memory>

#include "sources/playback/Source.h"

namespace vespscope::sources {

// An endless drive through LTE, UMTS and GSM coverage that begins at `start` since 1970-01-01 00:00 UTC and is the same
// for the same `seed`. Every kind of metric occurs within the first two minutes.
[[nodiscard]] std::unique_ptr<EventStream> makeScenarioStream(std::uint64_t seed, std::chrono::nanoseconds start);

}  // namespace vespscope::sources
