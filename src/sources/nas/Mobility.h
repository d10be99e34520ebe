// Mobility management messages of GSM and UMTS (3GPP TS 24.008 9.2 and 9.4): circuit (MM) and packet (GMM) domain.
#pragma once

#include <optional>
#include <vector>

#include "sources/nas/Identities.h"

namespace vespscope::sources::nas {

enum class Domain { circuit, packet };

enum class MobilityKind {
  attachRequest,  // packet domain only
  attachAccept,   // packet domain only
  attachReject,   // packet domain only
  updateRequest,  // of the location area or the routing area
  updateAccept,
  updateReject,
  serviceRequest,
  serviceAccept,  // packet domain only
  serviceReject,
  detach,       // of this domain only
  newIdentity,  // (P-)TMSI reallocation
  authenticationReject,
};

struct MobilityMessage {
  Domain domain = Domain::circuit;
  MobilityKind kind = MobilityKind::attachRequest;
  // The type of a request (10.5.3.5, 10.5.5.2, 10.5.5.18), or the result of an accept.
  std::optional<std::uint8_t> type;
  std::optional<LocationArea> locationArea;
  std::optional<std::uint8_t> routingAreaCode;      // within the location area
  std::optional<std::uint32_t> temporaryIdentity;   // of the domain: TMSI or P-TMSI
  std::optional<std::uint32_t> tmsi;                // of the circuit domain, in a combined accept of the packet domain
  std::optional<std::uint32_t> updateTimerSeconds;  // T3312
  std::vector<Plmn> equivalentPlmns;
  std::optional<std::uint8_t> cause;  // of a reject (10.5.3.6, 10.5.5.14)
};

// Empty for other messages, and for one whose mandatory part is truncated.
[[nodiscard]] std::optional<MobilityMessage> mobilityMessageOf(Span bytes);

}  // namespace vespscope::sources::nas
