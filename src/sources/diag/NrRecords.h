// The supported log records of NR's radio.
#pragma once

#include <cstdint>
#include <span>

#include "sources/diag/Decoded.h"

namespace vespscope::sources::diag {

inline constexpr std::uint16_t nrRrcMessageCode = 0xB821;

// The content of a B821: a message of a channel, or an information element from an LTE message.
enum class NrRrcContent : std::uint8_t {
  masterInformation = 1,
  uplinkDcch = 8,
  reconfiguration = 9,
  reconfigurationComplete = 10,
  capabilities = 25,
  radioBearerConfiguration = 26,
  other = 0,
};

// B821: one RRC message.
struct NrRrcMessageRecord {
  std::uint16_t pci = 0;      // 0..1007, 3GPP TS 38.211 7.4.2.1
  std::uint32_t nrArfcn = 0;  // 0..3279165, 3GPP TS 38.104 5.4.2.1
  NrRrcContent content = NrRrcContent::other;
  std::uint8_t radioBearer = 0;
  std::span<const std::uint8_t> message;  // unaligned PER; a view of the record
};
[[nodiscard]] Decoded<NrRrcMessageRecord> nrRrcMessageOf(std::span<const std::uint8_t> payload);

}  // namespace vespscope::sources::diag
