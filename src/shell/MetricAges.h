// When each metric was last reported, and which technology serves the phone: the basis of a screen's age.
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

  // The clock for ages.
  struct Source {
    bool connected = true;  // to the baseband manager
    bool recorded = false;  // ages are by the recording's own clock
    // The recording's own clock at its present position, since 1970-01-01 UTC. If unknown, the newest report's own time
    // is used.
    std::optional<std::chrono::nanoseconds> recordingClock;
  };

  // Records a report of a metric. `own` is the report's own time since 1970-01-01 UTC; a report without one counts as
  // new as the newest so far. Unregistered identifiers are ignored.
  void note(std::int64_t identifier, std::optional<std::chrono::nanoseconds> own, Clock::time_point arrival);

  // The age of the metric's latest report; without an age before the first report.
  [[nodiscard]] application::ScreenAge ageOf(std::int64_t identifier, const Source& source,
                                             Clock::time_point now) const;

 private:
  struct Report {
    Clock::time_point arrival;
    std::chrono::nanoseconds recorded{0};  // own time and `earlierRounds_` at that time
  };

  std::array<std::optional<Report>, metricRows.size()> reports_;
  std::optional<std::chrono::nanoseconds> newestOwn_;  // of this round
  // The total time of earlier rounds: a recording that is repeated starts each round at its original time.
  std::chrono::nanoseconds earlierRounds_{0};
  unsigned serving_ = 0;  // the technology, as a bit; 0 while unknown
};

}  // namespace vespscope
