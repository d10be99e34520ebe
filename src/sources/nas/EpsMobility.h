// EPS mobility management messages (3GPP TS 24.301 8.2): attach, detach, tracking area update, service request.
#pragma once

#include <optional>
#include <vector>

#include "sources/nas/Identities.h"

namespace vespscope::sources::nas {

enum class EpsMobilityKind {
  attachRequest,
  attachAccept,
  attachComplete,
  attachReject,
  updateRequest,
  updateAccept,
  updateComplete,
  updateReject,
  serviceRequest,
  serviceReject,
  detachRequest,
  detachAccept,
};

struct EpsMobilityMessage {
  EpsMobilityKind kind = EpsMobilityKind::attachRequest;
  // The EPS attach type (9.9.3.11), update type (9.9.3.14) or detach type (9.9.3.7) of a request, or the result of an
  // accept.
  std::optional<std::uint8_t> type;
  bool switchOff = false;  // of a detach by the phone: it does not wait for the answer
  // The usage setting of a request (3GPP TS 24.008 10.5.5.28).
  std::optional<bool> dataCentric;
  // Of an accept; if empty, the previous list stays valid.
  std::vector<TrackingArea> trackingAreas;
  std::optional<Guti> guti;
  std::optional<LocationArea> locationArea;
  std::optional<std::uint32_t> tmsi;
  std::vector<Plmn> equivalentPlmns;
  std::optional<std::uint32_t> updateTimerSeconds;  // T3412
  std::optional<bool> imsVoice;
  std::optional<bool> emergencyBearers;
  // The EMM cause (9.9.3.9) of a reject, or of an accept for EPS services only.
  std::optional<std::uint8_t> cause;
  // The session message inside an attach message; a view of the message.
  Span session;
};

// Empty for other messages, for protected ones, and for one whose mandatory part is truncated.
[[nodiscard]] std::optional<EpsMobilityMessage> epsMobilityMessageOf(Span bytes);

}  // namespace vespscope::sources::nas
