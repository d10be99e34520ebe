// EPS session management messages (3GPP TS 24.301 8.3) that begin and end bearers.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "sources/nas/PacketConfiguration.h"

namespace vespscope::sources::nas {

enum class EpsSessionKind {
  activateDefault,  // from the network, like all that are not an answer
  activateDedicated,
  modify,
  deactivate,
  accepted,  // an activation
  rejected,  // an activation
  deactivated,
};

struct EpsSessionMessage {
  EpsSessionKind kind = EpsSessionKind::activateDefault;
  std::uint8_t bearer = 0;                   // EPS bearer identity, 5..15
  std::optional<std::uint8_t> linked;        // of a dedicated bearer: its default bearer
  std::optional<std::uint8_t> qualityClass;  // QCI, 3GPP TS 23.203 6.1.7
  std::optional<std::string> accessPoint;
  std::optional<PacketAddress> address;
  std::vector<Bytes> nameServers;
};

// Empty for other messages, for an invalid bearer identity, and for one whose mandatory part is truncated.
[[nodiscard]] std::optional<EpsSessionMessage> epsSessionMessageOf(Span bytes);

}  // namespace vespscope::sources::nas
