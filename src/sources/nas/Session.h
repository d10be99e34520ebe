// Session management messages of GSM and UMTS (3GPP TS 24.008 9.5) that begin and end packet contexts.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "sources/nas/PacketConfiguration.h"

namespace vespscope::sources::nas {

enum class SessionKind { activateRequest, activateAccept, activateReject, deactivateRequest, deactivateAccept };

struct SessionMessage {
  SessionKind kind = SessionKind::activateRequest;
  std::uint8_t transaction = 0;               // 0..6, or the extended 0..127 (3GPP TS 24.007 11.2.3.1.3)
  std::optional<std::uint8_t> accessPointId;  // NSAPI 5..15, of a request
  std::optional<std::string> accessPoint;
  std::optional<PacketAddress> address;
  std::vector<Bytes> nameServers;
};

// Empty for other messages, and for one whose mandatory part is truncated.
[[nodiscard]] std::optional<SessionMessage> sessionMessageOf(Span bytes);

}  // namespace vespscope::sources::nas
