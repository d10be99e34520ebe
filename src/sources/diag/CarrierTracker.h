// Combines the measurements of the primary cell and of the secondary carriers: levels of all serving cells, carrier
// aggregation status, carriers in use.
#pragma once

#include <chrono>
#include <cstdint>
#include <map>
#include <optional>
#include <vector>

#include "sources/diag/EventList.h"
#include "sources/diag/LteRecords.h"

namespace vespscope::sources::diag {

class CarrierTracker {
 public:
  void take(const ServingMeasurementRecord& record, EventList& out);
  // Takes levels of the primary cell from another source than its measurement record; ignored while that record is
  // logged.
  void takeReported(const CellName& cell, double rsrp, std::optional<double> rsrq, EventList& out) const;
  // Reports secondaries that have not been measured lately as deconfigured.
  void expire(EventList& out);
  // Reports all secondaries as deconfigured: the connection has ended.
  void endConnection(EventList& out);

 private:
  struct Secondary {
    ServingMeasurement measurement;
    std::chrono::nanoseconds time{0};
  };
  struct Carriers {
    std::uint32_t primary = 0;
    std::vector<std::uint32_t> secondaries;
    bool operator==(const Carriers&) const = default;
  };

  void drop(const std::vector<Secondary>& gone, EventList& out);
  void reportLevels(EventList& out) const;
  void reportStatus(const std::vector<Secondary>& gone, EventList& out) const;
  void reportCarriers(EventList& out);

  std::optional<ServingMeasurement> primary_;
  std::chrono::nanoseconds primaryAt_{0};
  std::map<std::uint8_t, Secondary> secondaries_;  // by cell index, 1..7
  std::optional<Carriers> reportedCarriers_;
};

}  // namespace vespscope::sources::diag
