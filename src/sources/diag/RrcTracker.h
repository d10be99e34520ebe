// Follows the RRC connection through its messages, reports every change of its state, and the state again while
// messages confirm it.
#pragma once

#include <chrono>
#include <cstdint>
#include <optional>

#include "messages/lte/KCellularLteRrcState.h"
#include "sources/diag/EventList.h"
#include "sources/diag/RrcMeaning.h"

namespace vespscope::sources::diag {

class RrcTracker {
 public:
  // Returns true when the message ended or replaced the connection, and secondary carriers with it (3GPP TS 36.331
  // 5.3.7.2, 5.3.12).
  bool take(const RrcMeaning& meaning, EventList& out);
  // An idle phone receives paging (3GPP TS 36.304 7.1).
  void takePaging(EventList& out);
  // Whether the connection is known to have ended.
  [[nodiscard]] bool isIdle() const;
  [[nodiscard]] bool isConnected() const;

 private:
  [[nodiscard]] bool confirmsOnly(RrcEvent event, std::chrono::nanoseconds time) const;
  // Reports the state again when that is due.
  void confirm(EventList& out);
  void report(EventList& out);

  std::optional<std::int32_t> state_;  // a value of LteRrcState
  std::chrono::nanoseconds since_{0};
  KCellularLteRrcState message_;  // as it was reported
  ReportedAt reportedAt_;
};

}  // namespace vespscope::sources::diag
