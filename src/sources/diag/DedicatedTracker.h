// Keeps what the network has set up in a connected phone, and reports discontinuous reception whenever it changes.
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
  // `serving` is the cell that sent the message: before a handover that it may order.
  void take(const rrc::lte::Reconfiguration& change, const CellName& serving, EventList& out);
  // The connection is gone, and its settings with it.
  void endConnection(EventList& out);
  // What the measurement measures; null when its configuration was not seen.
  [[nodiscard]] const rrc::lte::MeasurementObject* objectOf(std::uint8_t measurement) const;

 private:
  void measure(const rrc::lte::MeasurementConfiguration& change);
  // A handover to another carrier exchanges the objects of the two (3GPP TS 36.331 5.5.6.1).
  void exchangeObjects(std::uint32_t source, std::uint32_t target);
  void report(EventList& out) const;

  std::optional<rrc::lte::DiscontinuousReception> reception_;
  std::map<std::uint8_t, rrc::lte::MeasurementObject> objects_;
  std::map<std::uint8_t, std::uint8_t> measurements_;  // to their objects
};

}  // namespace vespscope::sources::diag
