// Reports the GSM cell from its system information.
#pragma once

#include <optional>

#include "sources/diag/EventList.h"
#include "sources/diag/GsmSystemInformation.h"

namespace vespscope::sources::diag {

class GsmTracker {
 public:
  void take(const GsmSystemInformation& information, EventList& out);

 private:
  void describe(const GsmCellDescription& cell, EventList& out);
  void remind(const GsmCellReminder& cell, EventList& out);
  void report(EventList& out) const;

  std::optional<GsmCellDescription> cell_;
  std::optional<bool> cellBroadcast_;  // of that cell
};

}  // namespace vespscope::sources::diag
