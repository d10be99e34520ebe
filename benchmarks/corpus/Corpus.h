// Metric events made from a seed, for measurements that have to see the same events every time.
#pragma once

#include <cstddef>
#include <cstdint>
#include <vector>

#include "values/MetricEvent.h"

namespace vespscope::bench {

struct CorpusShape {
  std::uint32_t seed = 1;
  std::size_t eventsPerMetric = 300;
  std::size_t leastElements = 1;  // of each list; the SIM card files are always twelve
  std::size_t mostElements = 8;
  double presence = 0.9;  // how likely an optional field is there
  bool mixed = true;      // the metrics in random order, else one after the other
};

// Events of all 29 handled metrics with plausible values. The same shape gives the same bytes everywhere.
[[nodiscard]] std::vector<MetricEvent> makeCorpus(const CorpusShape& shape = {});

// A metric of which only one list grows, with `elements` elements: the LTE neighbour cell measurement.
[[nodiscard]] MetricEvent makeNeighbours(std::size_t elements, std::uint32_t seed = 1);

}  // namespace vespscope::bench
