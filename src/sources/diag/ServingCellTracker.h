// Tracks the serving cell and reports it: in full when the modem describes it, by carrier and physical identity only
// when just messages and measurements name it.
#pragma once

#include <chrono>
#include <optional>

#include "sources/diag/BroadcastTracker.h"
#include "sources/diag/EventList.h"
#include "sources/diag/LteRecords.h"

namespace vespscope::sources::diag {

class ServingCellTracker {
 public:
  void describe(const ServingCellRecord& record, EventList& out);
  // Messages and measurements show a cell change before, or without, a description. `broadcast` is the cell's own; null
  // when it was not received.
  void name(const CellName& cell, const CellBroadcast* broadcast, EventList& out);
  // Adds what the modem does not describe from the serving cell's broadcast.
  void supplement(const CellBroadcast& broadcast, EventList& out);
  [[nodiscard]] const std::optional<CellName>& current() const { return current_; }
  // Returns the downlink bandwidth of the current cell in resource blocks: as the modem describes it, else from
  // `broadcast`, which is null when the cell's was not received.
  [[nodiscard]] std::optional<std::uint8_t> downlinkBlocks(const CellBroadcast* broadcast) const;
  // Whether the modem logs descriptions of its cells.
  [[nodiscard]] bool hasDescriptions() const { return described_.has_value(); }

 private:
  void report(const CellName& cell, const CellBroadcast* broadcast, EventList& out);

  std::optional<CellName> current_;
  std::optional<ServingCellRecord> described_;
  std::chrono::nanoseconds describedAt_{0};
  Bytes reported_;  // the last report without a description, without its timestamp
};

}  // namespace vespscope::sources::diag
