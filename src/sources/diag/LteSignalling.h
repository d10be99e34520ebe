// Reads LTE's RRC messages for what they say beside the state of the connection: what cells broadcast, what the network
// has set up, and the levels that the phone reports.
#pragma once

#include "rrc/Message.h"
#include "sources/diag/BroadcastTracker.h"
#include "sources/diag/CarrierTracker.h"
#include "sources/diag/DedicatedTracker.h"
#include "sources/diag/NeighbourTracker.h"
#include "sources/diag/ServingCellTracker.h"

namespace vespscope::sources::diag {

class LteSignalling {
 public:
  // Whom the levels of measurement reports go to; they prefer what the modem measures by itself.
  struct Levels {
    CarrierTracker& carriers;
    NeighbourTracker& neighbours;
  };

  // A message of LTE, not of NB-IoT. `serving` already knows the cell of a dedicated message.
  void take(const RrcMessageRecord& record, ServingCellTracker& serving, Levels levels, EventList& out);
  // What the cell has broadcast; null when it was not heard.
  [[nodiscard]] const CellBroadcast* broadcastOf(const CellName& cell) const { return broadcasts_.find(cell); }
  // The serving cell is another: reports what it has broadcast, as far as that was heard.
  void reportBroadcast(const CellName& serving, EventList& out) { broadcasts_.report(serving, out); }
  // The connection is gone.
  void endConnection(EventList& out) { dedicated_.endConnection(out); }

 private:
  void takeBroadcast(const RrcMessageRecord& record, ServingCellTracker& serving, EventList& out);
  void takeReport(const RrcMessageRecord& record, Levels levels, EventList& out);

  rrc::Message message_;  // keeps its memory
  BroadcastTracker broadcasts_;
  DedicatedTracker dedicated_;
};

}  // namespace vespscope::sources::diag
