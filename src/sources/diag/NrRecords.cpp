#include "sources/diag/NrRecords.h"

#include "sources/diag/ByteView.h"

namespace vespscope::sources::diag {
namespace {

NrRrcContent contentOf(std::uint8_t type) {
  const auto content = static_cast<NrRrcContent>(type);
  switch (content) {
    case NrRrcContent::masterInformation:
    case NrRrcContent::uplinkDcch:
    case NrRrcContent::reconfiguration:
    case NrRrcContent::reconfigurationComplete:
    case NrRrcContent::capabilities:
    case NrRrcContent::radioBearerConfiguration:
      return content;
    case NrRrcContent::other:
      break;
  }
  return NrRrcContent::other;
}

}  // namespace

Decoded<NrRrcMessageRecord> nrRrcMessageOf(std::span<const std::uint8_t> payload) {
  constexpr std::size_t head = 24;
  constexpr std::uint16_t highestNrPci = 1007;
  constexpr std::uint32_t highestNrArfcn = 3'279'165;
  const ByteView bytes(payload);
  if (!bytes.holds(0, 4)) return RecordFault::tooShort;
  if (bytes.u32(0) != 8) return RecordFault::unknownVersion;
  if (!bytes.holds(0, head)) return RecordFault::tooShort;
  const std::size_t length = bytes.u16(22);
  if (!bytes.holds(head, length)) return RecordFault::tooShort;
  if (bytes.size() != head + length) return RecordFault::bytesLeft;
  const NrRrcMessageRecord record{bytes.u16(7), bytes.u32(9), contentOf(bytes.u8(17)), bytes.u8(6),
                                  bytes.part(head, length)};
  if (record.pci > highestNrPci || record.nrArfcn > highestNrArfcn) return RecordFault::outOfRange;
  return record;
}

}  // namespace vespscope::sources::diag
