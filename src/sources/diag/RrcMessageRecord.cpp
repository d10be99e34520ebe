#include <algorithm>
#include <array>
#include <optional>

#include "sources/diag/ByteView.h"
#include "sources/diag/LteRecords.h"

namespace vespscope::sources::diag {
namespace {

// The numbers of the channels in the versions of the record; 0 if a version has no such channel.
constexpr std::size_t channelCount = static_cast<std::size_t>(RrcChannel::other);
struct Numbering {
  std::array<std::uint8_t, 8> versions;
  std::array<std::uint8_t, channelCount> channels;  // in the order of RrcChannel
};
constexpr std::array<Numbering, 5> numberings = {{
    {{2, 3, 4, 5, 6, 7, 8, 13}, {1, 2, 3, 4, 5, 6, 7, 8}},
    {{22}, {1, 2, 3, 4, 5, 6, 7, 8}},
    {{9, 12}, {8, 9, 10, 11, 12, 13, 14, 15}},
    {{14, 15, 16, 20, 24, 25}, {1, 2, 4, 5, 6, 7, 8, 9}},
    {{19, 26, 27, 29, 30, 31}, {1, 3, 6, 7, 8, 9, 10, 11}},
}};
// The same for NB-IoT, which has no multicast channel.
constexpr std::array<Numbering, 2> narrowbandNumberings = {{
    {{19, 26}, {45, 46, 0, 47, 48, 49, 50, 52}},
    {{20}, {54, 55, 0, 56, 57, 58, 59, 61}},
}};

const Numbering* numberingOf(std::span<const Numbering> all, std::uint8_t version) {
  for (const Numbering& numbering : all) {
    const auto& versions = numbering.versions;
    if (std::find(versions.begin(), versions.end(), version) != versions.end()) return &numbering;
  }
  return nullptr;
}

RrcChannel channelOf(const Numbering* numbering, std::uint8_t type) {
  if (numbering == nullptr || type == 0) return RrcChannel::other;
  const auto& channels = numbering->channels;
  return static_cast<RrcChannel>(std::find(channels.begin(), channels.end(), type) - channels.begin());
}

// The offsets of the fields of a version.
struct Layout {
  explicit Layout(std::uint8_t version)
      : bearer(version >= 25 ? 5 : 3),  // after the version and the releases
        wideEarfcn(version >= 8),
        type(bearer + (wideEarfcn ? 9 : 7)),
        length(type + (version <= 4 ? 1 : 5)) {}  // after the mask of system information blocks

  std::size_t bearer;
  bool wideEarfcn;
  std::size_t type;
  std::size_t length;
};

// Returns the message, which ends with the record. Versions 30 and 31 occur with and without three preceding bytes.
Decoded<std::span<const std::uint8_t>> messageOf(const ByteView& bytes, const Layout& layout, std::uint8_t version) {
  constexpr std::size_t lengthWidth = 2;
  constexpr std::size_t extraHead = 3;
  const std::size_t announced = bytes.u16(layout.length);
  const std::size_t left = bytes.size() - layout.length - lengthWidth;
  if (left == announced) return bytes.part(layout.length + lengthWidth, announced);
  if ((version == 30 || version == 31) && left == announced + extraHead) {
    return bytes.part(layout.length + lengthWidth + extraHead, announced);
  }
  return left < announced ? RecordFault::tooShort : RecordFault::bytesLeft;
}

}  // namespace

Decoded<RrcMessageRecord> rrcMessageOf(std::span<const std::uint8_t> payload) {
  const ByteView bytes(payload);
  if (!bytes.holds(0, 1)) return RecordFault::tooShort;
  const std::uint8_t version = bytes.u8(0);
  const Numbering* numbering = version == 0 ? nullptr : numberingOf(numberings, version);
  if (numbering == nullptr) return RecordFault::unknownVersion;
  const Layout layout(version);
  if (!bytes.holds(0, layout.length + 2)) return RecordFault::tooShort;
  const auto message = messageOf(bytes, layout, version);
  if (const auto* fault = std::get_if<RecordFault>(&message)) return *fault;
  RrcMessageRecord record;
  const std::size_t earfcn = layout.bearer + 3;
  record.cell = {layout.wideEarfcn ? bytes.u32(earfcn) : bytes.u16(earfcn), bytes.u16(layout.bearer + 1)};
  const std::uint8_t type = bytes.u8(layout.type);
  record.channel = channelOf(numbering, type);
  if (record.channel == RrcChannel::other) {
    record.channel = channelOf(numberingOf(narrowbandNumberings, version), type);
    record.narrowband = record.channel != RrcChannel::other;
  }
  record.radioBearer = bytes.u8(layout.bearer);
  record.message = std::get<std::span<const std::uint8_t>>(message);
  if (record.cell.pci > highestPci) return RecordFault::outOfRange;
  return record;
}

}  // namespace vespscope::sources::diag
