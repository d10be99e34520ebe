// What a recording's screens show at the moment where playing starts: the latest event of each metric and profile
// before it.
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

  // Takes an event in place of the one before of its metric and profile. One beyond the limits is left out.
  void take(MetricEvent event);
  // Returns the events in the order in which they were taken, and is empty afterwards.
  [[nodiscard]] std::vector<MetricEvent> release();
  // Events left out since the last release.
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
