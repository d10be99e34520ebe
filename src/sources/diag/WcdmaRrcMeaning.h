// The meaning of a UMTS RRC message for the state of the connection, and its message to or from the core network (3GPP
// TS 25.331 8.1, 8.3 and 11).
#pragma once

#include <cstdint>
#include <optional>
#include <span>

#include "sources/diag/WcdmaRecords.h"
#include "values/Value.h"

namespace vespscope::sources::diag {

enum class WcdmaRrcEvent {
  connectionRequest,
  connectionSetup,
  connectionSetupComplete,
  connectionReject,
  connectionRelease,
  connectionReleaseComplete,
  signallingReleaseIndication,
  cellUpdate,  // of the cell or the URA
  radioLinkFailure,
  dedicatedChannelMessage,  // one that exists in CELL_DCH only
  directTransfer,
};

struct WcdmaRrcMeaning {
  WcdmaRrcEvent event = WcdmaRrcEvent::connectionRequest;
  // The cause field: EstablishmentCause, RejectionCause or ReleaseCause.
  std::optional<unsigned> cause;
  // For a setup, RRC-StateIndicator: 0 CELL_DCH, 1 CELL_FACH.
  std::optional<unsigned> state;
  // For a reject: whether it redirects the phone.
  bool redirected = false;
  // For a direct transfer.
  Bytes nasMessage;
  bool operator==(const WcdmaRrcMeaning&) const = default;
};

// Empty for a message without such a meaning, and for one truncated before it.
[[nodiscard]] std::optional<WcdmaRrcMeaning> wcdmaRrcMeaningOf(WcdmaChannel channel,
                                                               std::span<const std::uint8_t> message);

}  // namespace vespscope::sources::diag
