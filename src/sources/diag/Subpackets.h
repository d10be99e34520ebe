// The parts of records that consist of subpackets: version and count of the record, then for each subpacket its kind,
// its version and its size, which includes these four bytes.
#pragma once

#include <optional>

#include "sources/diag/ByteView.h"
#include "sources/diag/Decoded.h"

namespace vespscope::sources::diag {

struct Subpacket {
  std::uint8_t kind = 0;
  std::uint8_t version = 0;
  ByteView body;
};

// Calls `take(const Subpacket&)` with each subpacket until one returns a fault; returns that fault, if any.
template <class Take>
std::optional<RecordFault> forEachSubpacket(std::span<const std::uint8_t> payload, const Take& take) {
  constexpr std::size_t head = 4;
  const ByteView bytes(payload);
  if (!bytes.holds(0, head)) return RecordFault::tooShort;
  if (bytes.u8(0) != 1) return RecordFault::unknownVersion;
  std::size_t position = head;
  for (unsigned left = bytes.u8(1); left > 0; --left) {
    if (!bytes.holds(position, head)) return RecordFault::tooShort;
    const std::size_t size = bytes.u16(position + 2);
    if (size < head || !bytes.holds(position, size)) return RecordFault::tooShort;
    const Subpacket subpacket{bytes.u8(position), bytes.u8(position + 1),
                              ByteView(bytes.part(position + head, size - head))};
    if (const std::optional<RecordFault> fault = take(subpacket)) return fault;
    position += size;
  }
  return std::nullopt;
}

}  // namespace vespscope::sources::diag
