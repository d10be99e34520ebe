// Reads LTE's RRC messages for everything except the state of the connection: broadcasts of cells, the network's
// configuration, and the phone's reported levels.
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
  // The receivers of reported levels; they prefer the modem's own measurements.
  struct Levels {
    CarrierTracker& carriers;
    NeighbourTracker& neighbours;
  };

  // Takes a message of LTE, not of NB-IoT. `serving` already has the cell of a dedicated message.
  void take(const RrcMessageRecord& record, ServingCellTracker& serving, Levels levels, EventList& out);
  // The cell's broadcast; null when it was not received.
  [[nodiscard]] const CellBroadcast* broadcastOf(const CellName& cell) const { return broadcasts_.find(cell); }
  // Reports the new serving cell's broadcast, as far as it was received.
  void reportBroadcast(const CellName& serving, EventList& out) { broadcasts_.report(serving, out); }
  // Ends the connection.
  void endConnection(EventList& out) { dedicated_.endConnection(out); }

 private:
  void takeBroadcast(const RrcMessageRecord& record, ServingCellTracker& serving, EventList& out);
  void takeChange(const rrc::lte::Reconfiguration& change, const CellName& serving, CarrierTracker& carriers,
                  EventList& out);
  void takeReport(const RrcMessageRecord& record, Levels levels, EventList& out);

  rrc::Message message_;  // a member, to reuse its memory
  BroadcastTracker broadcasts_;
  DedicatedTracker dedicated_;
};

}  // namespace vespscope::sources::diag
