#include "sources/diag/WcdmaRecords.h"

#include "sources/diag/ByteView.h"

namespace vespscope::sources::diag {
Decoded<WcdmaCellRecord> wcdmaCellOf(std::span<const std::uint8_t> payload) {
  constexpr std::size_t length = 32;
  constexpr std::uint16_t highestScramblingCode = 511;
  constexpr std::uint32_t highestArea = 0xFFFF;
  const ByteView bytes(payload);
  if (!bytes.holds(0, length)) return RecordFault::tooShort;
  WcdmaCellRecord record;
  record.uplinkUarfcn = bytes.u32(0);
  record.downlinkUarfcn = bytes.u32(4);
  record.cellIdentity = bytes.u32(8);
  record.primaryScramblingCode = bytes.u16(16) >> 4U;
  record.plmn = radio::Plmn::fromDigitOctets(bytes.part(18, 6));
  const std::uint32_t area = bytes.u32(24);
  const std::uint32_t routingArea = bytes.u32(28);
  if (record.primaryScramblingCode > highestScramblingCode || area > highestArea) return RecordFault::outOfRange;
  record.locationAreaCode = static_cast<std::uint16_t>(area);
  record.routingAreaCode = static_cast<std::uint8_t>(routingArea);
  return record;
}

Decoded<WcdmaRrcRecord> wcdmaRrcOf(std::span<const std::uint8_t> payload) {
  constexpr std::size_t head = 4;
  const ByteView bytes(payload);
  if (!bytes.holds(0, 1)) return RecordFault::tooShort;
  const std::uint8_t channel = bytes.u8(0);
  if (channel > static_cast<std::uint8_t>(WcdmaChannel::downlinkDcch)) return RecordFault::unknownVersion;
  if (!bytes.holds(0, head) || !bytes.holds(head, bytes.u16(2))) return RecordFault::tooShort;
  return WcdmaRrcRecord{static_cast<WcdmaChannel>(channel), bytes.u8(1), bytes.part(head, bytes.u16(2))};
}

}  // namespace vespscope::sources::diag
