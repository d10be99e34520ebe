// Knows the serving cell and reports it: in full when the modem describes it, by carrier and physical identity alone
// when only messages and measurements name it.
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
  // A cell change shows in messages and measurements before, or without, a description. `broadcast` is what the cell
  // says of itself; null when it was not heard.
  void name(const CellName& cell, const CellBroadcast* broadcast, EventList& out);
  // The serving cell's broadcast fills in what the modem does not describe.
  void supplement(const CellBroadcast& broadcast, EventList& out);
  [[nodiscard]] const std::optional<CellName>& current() const { return current_; }
  // Whether the modem describes its cells by itself.
  [[nodiscard]] bool hasDescriptions() const { return described_.has_value(); }

 private:
  void report(const CellName& cell, const CellBroadcast* broadcast, EventList& out);

  std::optional<CellName> current_;
  std::optional<ServingCellRecord> described_;
  std::chrono::nanoseconds describedAt_{0};
  Bytes reported_;  // what was last reported without a description, without its timestamp
};

}  // namespace vespscope::sources::diag
