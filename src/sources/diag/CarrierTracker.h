// Combines the primary cell and the secondary carriers, as the network configures them and as the modem measures them:
// levels of all serving cells, carrier aggregation status, component carriers.
#pragma once

#include <chrono>
#include <cstdint>
#include <map>
#include <optional>
#include <vector>

#include "rrc/lte/Reconfiguration.h"
#include "sources/diag/EventList.h"
#include "sources/diag/LteRecords.h"

namespace vespscope::sources::diag {

class CarrierTracker {
 public:
  // Names the primary cell, with its downlink bandwidth in resource blocks where that is known.
  void serve(const CellName& cell, std::optional<std::uint8_t> blocks, EventList& out);
  // A measured secondary is activated.
  void take(const ServingMeasurementRecord& record, EventList& out);
  // Adds, changes and releases secondaries as the network orders.
  void take(const rrc::lte::Reconfiguration& change, EventList& out);
  // Takes levels of the primary cell from another source than its measurement record; ignored while that record is
  // logged.
  void takeReported(const CellName& cell, double rsrp, std::optional<double> rsrq, EventList& out) const;
  // Reports secondaries that have not been measured lately: as deactivated where the network's configuration is known,
  // else as deconfigured.
  void expire(EventList& out);
  // Reports all secondaries as deconfigured: the connection has ended.
  void endConnection(EventList& out);

 private:
  // At least one of both is present.
  struct Secondary {
    std::optional<rrc::lte::SecondaryCell> configured;
    std::optional<ServingMeasurement> measured;  // lately
    std::chrono::nanoseconds measuredAt{0};
    // Carrier and physical identity, as measured, else as configured.
    [[nodiscard]] CellName name() const;
  };
  using Secondaries = std::map<std::uint8_t, Secondary>;  // by cell index, 1..31

  struct Carrier {
    std::uint32_t earfcn = 0;
    std::optional<std::uint8_t> blocks;
    bool operator==(const Carrier&) const = default;
  };

  [[nodiscard]] bool isLate(const ServingMeasurement& cell, std::chrono::nanoseconds time) const;
  void configure(const rrc::lte::SecondaryCell& cell);
  // Moves the cell from secondaries_ to `gone`.
  void release(std::uint8_t index, Secondaries& gone);
  void reportChange(const Secondaries& gone, EventList& out);
  void reportLevels(EventList& out) const;
  void reportStatus(const Secondaries& gone, EventList& out) const;
  void reportCarriers(EventList& out);

  std::optional<Carrier> primaryCarrier_;
  std::optional<ServingMeasurement> primary_;
  std::chrono::nanoseconds primaryAt_{0};
  Secondaries secondaries_;
  // What the last message released: the modem may still log a measurement of it.
  Secondaries released_;
  std::chrono::nanoseconds releasedAt_{0};
  std::vector<Carrier> reportedCarriers_;  // the primary's first
};

}  // namespace vespscope::sources::diag
