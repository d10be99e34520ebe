#include "sources/diag/ByteView.h"
#include "sources/diag/LteRecords.h"

namespace vespscope::sources::diag {

Decoded<ServingCellRecord> servingCellOf(std::span<const std::uint8_t> payload) {
  const ByteView bytes(payload);
  if (!bytes.holds(0, 1)) return RecordFault::tooShort;
  const std::uint8_t version = bytes.u8(0);
  if (version != 2 && version != 3) return RecordFault::unknownVersion;
  const std::size_t earfcnWidth = version == 2 ? 2 : 4;
  const std::size_t rest = 3 + 2 * earfcnWidth;  // after the two EARFCNs
  constexpr std::size_t restLength = 18;
  if (!bytes.holds(rest, restLength)) return RecordFault::tooShort;
  const auto earfcn = [&](std::size_t offset) -> std::uint32_t {
    return earfcnWidth == 2 ? bytes.u16(offset) : bytes.u32(offset);
  };
  ServingCellRecord record;
  record.cell = {earfcn(3), bytes.u16(1)};
  record.uplinkEarfcn = earfcn(3 + earfcnWidth);
  record.downlinkBlocks = bytes.u8(rest);
  record.uplinkBlocks = bytes.u8(rest + 1);
  record.cellIdentity = bytes.u32(rest + 2);
  record.trackingAreaCode = bytes.u16(rest + 6);
  record.band = bytes.u32(rest + 8);
  record.plmn = radio::Plmn::fromNumbers(bytes.u16(rest + 12), bytes.u16(rest + 15), bytes.u8(rest + 14));
  if (record.cell.pci > highestPci) return RecordFault::outOfRange;
  return record;
}

}  // namespace vespscope::sources::diag
