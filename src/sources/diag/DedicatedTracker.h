// Stores the network's configuration of a connected phone, and reports discontinuous reception whenever it changes.
#pragma once

#include <cstdint>
#include <map>
#include <optional>

#include "rrc/lte/Reconfiguration.h"
#include "sources/diag/EventList.h"
#include "sources/diag/LteRecords.h"

namespace vespscope::sources::diag {

class DedicatedTracker {
 public:
  // `serving` is the cell that sent the message: the one before a handover that the message may order.
  void take(const rrc::lte::Reconfiguration& change, const CellName& serving, EventList& out);
  // Removes the configuration: the connection has ended.
  void endConnection(EventList& out);
  // The object of a measurement; null when its configuration is not in the log.
  [[nodiscard]] const rrc::lte::MeasurementObject* objectOf(std::uint8_t measurement) const;

 private:
  void measure(const rrc::lte::MeasurementConfiguration& change);
  // A handover to another carrier exchanges the two carriers' objects (3GPP TS 36.331 5.5.6.1).
  void exchangeObjects(std::uint32_t source, std::uint32_t target);
  void report(EventList& out) const;

  std::optional<rrc::lte::DiscontinuousReception> reception_;
  std::map<std::uint8_t, rrc::lte::MeasurementObject> objects_;
  std::map<std::uint8_t, std::uint8_t> measurements_;  // maps to their objects
};

}  // namespace vespscope::sources::diag
