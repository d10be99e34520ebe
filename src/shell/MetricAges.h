// When each metric was last reported, and which technology serves the phone: what the age of a screen is made from.
#pragma once

#include <array>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <optional>

#include "platform/application/ScreenAge.h"
#include "registry/MetricRows.h"

namespace vespscope {

class MetricAges {
 public:
  using Clock = std::chrono::steady_clock;

  // Which clock ages are counted by.
  struct Source {
    bool connected = true;  // to the baseband manager
    bool recorded = false;  // ages are those on the recording's own clock
    // The recording's own clock at its present position, since 1970-01-01 UTC. Empty while unknown: then the newest
    // report's own time counts.
    std::optional<std::chrono::nanoseconds> recordingClock;
  };

  // Notes a report of a metric. `own` is the report's own time since 1970-01-01 UTC; a report without one counts as new
  // as the newest so far. Identifiers that are not registered are ignored.
  void note(std::int64_t identifier, std::optional<std::chrono::nanoseconds> own, Clock::time_point arrival);

  // The age of the metric's latest report; no age while none came.
  [[nodiscard]] application::ScreenAge ageOf(std::int64_t identifier, const Source& source,
                                             Clock::time_point now) const;

 private:
  struct Report {
    Clock::time_point arrival;
    std::chrono::nanoseconds recorded{0};  // own time and `earlierRounds_` at that time
  };

  std::array<std::optional<Report>, metricRows.size()> reports_;
  std::optional<std::chrono::nanoseconds> newestOwn_;  // of this round
  // A recording that is played again and again starts each time where it started first: how much time the rounds before
  // this one took.
  std::chrono::nanoseconds earlierRounds_{0};
  unsigned serving_ = 0;  // the technology, as a bit; 0 while unknown
};

}  // namespace vespscope
