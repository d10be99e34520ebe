// The security header of EPS NAS messages (3GPP TS 24.301 9.1 and 9.3.1).
#pragma once

#include <optional>

#include "sources/nas/Octets.h"

namespace vespscope::sources::nas {

// The plain message inside one as it is sent. Empty when it is ciphered, or truncated within its header.
[[nodiscard]] inline std::optional<Span> plainMessageIn(Span sent) {
  constexpr std::uint8_t mobility = 7;   // protocol discriminator
  constexpr std::size_t headLength = 6;  // with the authentication code and the sequence number
  if (sent.empty()) return std::nullopt;
  if ((sent[0] & 0xFU) != mobility) return sent;  // a session message, whose high half is a bearer
  switch (sent[0] >> 4U) {
    case 1:  // integrity protected
    case 3:  // with a new context
      if (sent.size() <= headLength) return std::nullopt;
      return sent.subspan(headLength);
    case 2:  // also ciphered
    case 4:
    case 5:
      return std::nullopt;
    default:  // plain, or a service request, whose header is part of it
      return sent;
  }
}

}  // namespace vespscope::sources::nas
