// Knows the serving cell and reports it: in full when the modem describes it, by carrier and physical identity alone
// when only messages and measurements name it.
#pragma once

#include <chrono>
#include <optional>

#include "sources/diag/EventList.h"
#include "sources/diag/LteRecords.h"

namespace vespscope::sources::diag {

class ServingCellTracker {
 public:
  void describe(const ServingCellRecord& record, EventList& out);
  // A cell change shows in messages and measurements before, or without, a description.
  void name(const CellName& cell, EventList& out);

 private:
  std::optional<CellName> current_;
  std::optional<ServingCellRecord> described_;
  std::chrono::nanoseconds describedAt_{0};
};

}  // namespace vespscope::sources::diag
