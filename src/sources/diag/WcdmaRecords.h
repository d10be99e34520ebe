// The supported log records of WCDMA's radio, as plain structures.
#pragma once

#include <cstdint>
#include <optional>
#include <span>

#include "radio/Plmn.h"
#include "sources/diag/Decoded.h"

namespace vespscope::sources::diag {

inline constexpr std::uint16_t wcdmaCellCode = 0x4127;
inline constexpr std::uint16_t wcdmaRrcCode = 0x412F;

// 4127: the cell that the phone camps on or is connected to.
struct WcdmaCellRecord {
  std::uint32_t uplinkUarfcn = 0;
  std::uint32_t downlinkUarfcn = 0;
  std::uint32_t cellIdentity = 0;           // 28 bits, 3GPP TS 25.331 10.3.2.2
  std::uint16_t primaryScramblingCode = 0;  // 0..511, 3GPP TS 25.213 5.2.1
  std::optional<radio::Plmn> plmn;          // empty when its digits are invalid
  std::uint16_t locationAreaCode = 0;
  std::uint8_t routingAreaCode = 0;
  bool operator==(const WcdmaCellRecord&) const = default;
};
[[nodiscard]] Decoded<WcdmaCellRecord> wcdmaCellOf(std::span<const std::uint8_t> payload);

// 412F: one RRC message.
enum class WcdmaChannel : std::uint8_t { uplinkCcch = 0, uplinkDcch = 1, downlinkCcch = 2, downlinkDcch = 3 };
struct WcdmaRrcRecord {
  WcdmaChannel channel = WcdmaChannel::uplinkCcch;
  std::uint8_t radioBearer = 0;
  std::span<const std::uint8_t> message;  // unaligned PER; a view of the record
};
// A message of another channel, such as a broadcast, counts as an unknown version.
[[nodiscard]] Decoded<WcdmaRrcRecord> wcdmaRrcOf(std::span<const std::uint8_t> payload);

}  // namespace vespscope::sources::diag
