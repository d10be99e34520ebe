// Stores the latest neighbour measurements of each carrier and reports them as one list, because a record covers one
// carrier only.
#pragma once

#include <chrono>
#include <cstdint>
#include <map>
#include <optional>
#include <vector>

#include "sources/diag/EventList.h"
#include "sources/diag/LteRecords.h"

namespace vespscope::sources::diag {

class NeighbourTracker {
 public:
  void take(const NeighbourMeasurementRecord& record, EventList& out);
  void take(const NeighbourCarriersRecord& record, EventList& out);
  // Takes the neighbours on one carrier from the phone's reports to the network; ignored while they are in measurement
  // records.
  void takeReported(std::uint32_t earfcn, const std::vector<NeighbourMeasurement>& neighbours, EventList& out);

 private:
  void keep(std::uint32_t earfcn, const std::vector<NeighbourMeasurement>& neighbours, const EventList& out);
  void report(EventList& out) const;

  struct Carrier {
    std::vector<NeighbourMeasurement> neighbours;
    std::chrono::nanoseconds time{0};
  };
  // More than a phone measures at a time; the oldest is removed.
  static constexpr std::size_t maximumCarriers = 16;

  std::map<std::uint32_t, Carrier> carriers_;  // by EARFCN
  std::optional<std::chrono::nanoseconds> measuredAt_;
};

}  // namespace vespscope::sources::diag
