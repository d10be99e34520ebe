#include <algorithm>
#include <initializer_list>
#include <optional>

#include "sources/diag/ByteView.h"
#include "sources/diag/LteRecords.h"

namespace vespscope::sources::diag {
namespace {

// The number that stands for DL-CCCH; DL-DCCH, UL-CCCH and UL-DCCH follow it. Empty for a version that is not known.
std::optional<unsigned> firstDedicatedChannel(std::uint8_t version) {
  const auto isOneOf = [version](std::initializer_list<std::uint8_t> versions) {
    return std::find(versions.begin(), versions.end(), version) != versions.end();
  };
  if (isOneOf({2, 3, 4, 6, 7, 8, 13, 22})) return 5;
  if (isOneOf({14, 15, 16, 20, 24, 25})) return 6;
  if (isOneOf({19, 26, 27, 29, 30, 31})) return 8;
  if (isOneOf({9, 12})) return 12;
  return std::nullopt;
}

RrcChannel channelOf(unsigned type, unsigned first) {
  if (type < first || type >= first + static_cast<unsigned>(RrcChannel::other)) return RrcChannel::other;
  return static_cast<RrcChannel>(type - first);
}

}  // namespace

Decoded<RrcMessageRecord> rrcMessageOf(std::span<const std::uint8_t> payload) {
  const ByteView bytes(payload);
  if (!bytes.holds(0, 1)) return RecordFault::tooShort;
  const std::uint8_t version = bytes.u8(0);
  const auto first = firstDedicatedChannel(version);
  if (!first) return RecordFault::unknownVersion;
  const std::size_t bearer = version >= 25 ? 5 : 3;  // behind version and releases
  const std::size_t earfcn = bearer + 3;
  const std::size_t frame = earfcn + (version < 8 ? 2 : 4);
  const std::size_t type = frame + 2;
  const std::size_t length = type + 5;  // behind the mask of system information blocks
  const std::size_t message = length + 2;
  if (!bytes.holds(0, message)) return RecordFault::tooShort;
  if (!bytes.holds(message, bytes.u16(length))) return RecordFault::tooShort;
  RrcMessageRecord record;
  record.cell = {version < 8 ? bytes.u16(earfcn) : bytes.u32(earfcn), bytes.u16(bearer + 1)};
  record.channel = channelOf(bytes.u8(type), *first);
  record.radioBearer = bytes.u8(bearer);
  record.message = bytes.part(message, bytes.u16(length));
  if (record.cell.pci > highestPci) return RecordFault::outOfRange;
  return record;
}

}  // namespace vespscope::sources::diag
