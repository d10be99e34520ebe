// The state at the moment where playing a recording starts: the latest earlier event of each metric and profile.
#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <utility>
#include <vector>

#include "values/MetricEvent.h"

namespace vespscope::sources {

class StateBefore {
 public:
  // A recording of this system's sources has a tenth as many metrics, by profile, and a thousandth of the bytes.
  static constexpr std::size_t metricLimit = 4096;
  static constexpr std::size_t byteLimit = std::size_t{16} << 20;  // of payloads

  // Takes an event in place of the previous one of its metric and profile. Events beyond the limits are skipped.
  void take(MetricEvent event);
  // Returns the events in the order in which they were taken, and clears the object.
  [[nodiscard]] std::vector<MetricEvent> release();
  // The number of events skipped since the last release.
  [[nodiscard]] std::uint64_t leftOut() const { return leftOut_; }

 private:
  struct Entry {
    std::uint64_t number = 0;  // counts all events taken
    MetricEvent event;
  };

  std::map<std::pair<std::int32_t, std::int32_t>, Entry> latest_;  // by metric and profile
  std::size_t bytes_ = 0;
  std::uint64_t taken_ = 0;
  std::uint64_t leftOut_ = 0;
};

}  // namespace vespscope::sources
