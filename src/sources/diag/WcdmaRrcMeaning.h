// What a UMTS RRC message tells about the state of the connection, and the message to or from the core network that it
// carries (3GPP TS 25.331 8.1, 8.3 and 11).
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
  dedicatedChannelMessage,  // one that only CELL_DCH knows
  directTransfer,
};

struct WcdmaRrcMeaning {
  WcdmaRrcEvent event = WcdmaRrcEvent::connectionRequest;
  // The cause field: EstablishmentCause, RejectionCause or ReleaseCause.
  std::optional<unsigned> cause;
  // Of a setup, RRC-StateIndicator: 0 CELL_DCH, 1 CELL_FACH.
  std::optional<unsigned> state;
  // Of a reject: whether it sends the phone elsewhere.
  bool redirected = false;
  // Of a direct transfer.
  Bytes nasMessage;
  bool operator==(const WcdmaRrcMeaning&) const = default;
};

// Empty for a message that tells nothing, and for one cut before it tells.
[[nodiscard]] std::optional<WcdmaRrcMeaning> wcdmaRrcMeaningOf(WcdmaChannel channel,
                                                               std::span<const std::uint8_t> message);

}  // namespace vespscope::sources::diag
