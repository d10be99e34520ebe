// The meaning of an LTE RRC message for the state of the connection (3GPP TS 36.331 5.3 and 6.2).
#pragma once

#include <cstdint>
#include <optional>
#include <span>

#include "sources/diag/LteRecords.h"

namespace vespscope::sources::diag {

enum class RrcEvent {
  connectionRequest,
  connectionSetupComplete,  // or the completion of a resume
  connectionReject,
  connectionRelease,
  reestablishmentRequest,
  reestablishmentComplete,
  reestablishmentReject,
  mobilityFromEutra,
  reconfigurationComplete,
  dedicatedMessage,  // any other that needs an RRC connection
};

struct RrcMeaning {
  RrcEvent event = RrcEvent::dedicatedMessage;
  // The cause field of the message: EstablishmentCause, ReleaseCause or ReestablishmentCause. Empty when the message
  // has none or has it in a form of a later release.
  std::optional<unsigned> cause;
  bool operator==(const RrcMeaning&) const = default;
};

// Empty for a message without such a meaning, for most extensions of later releases, and for a truncated one.
[[nodiscard]] std::optional<RrcMeaning> rrcMeaningOf(RrcChannel channel, std::span<const std::uint8_t> message);

}  // namespace vespscope::sources::diag
