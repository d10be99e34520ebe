// Follows the RRC connection through its messages and reports every change of its state.
#pragma once

#include <chrono>
#include <cstdint>
#include <optional>

#include "sources/diag/EventList.h"
#include "sources/diag/RrcMeaning.h"

namespace vespscope::sources::diag {

class RrcTracker {
 public:
  // Returns true when the message ended or replaced the connection, and secondary carriers with it (3GPP TS 36.331
  // 5.3.7.2, 5.3.12).
  bool take(const RrcMeaning& meaning, EventList& out);
  // Whether the connection is known to have ended.
  [[nodiscard]] bool isIdle() const;
  [[nodiscard]] bool isConnected() const;

 private:
  [[nodiscard]] bool confirmsOnly(RrcEvent event, std::chrono::nanoseconds time) const;

  std::optional<std::int32_t> state_;  // a value of LteRrcState
  std::chrono::nanoseconds since_{0};
};

}  // namespace vespscope::sources::diag
