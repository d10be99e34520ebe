// What each kind of number is on the wire, in a dictionary and in a hash.
#pragma once

#include <cstdint>

#include "messages/FieldTable.h"
#include "messages/WireWriter.h"

namespace vespscope {

// The number that a varint holds: its low 32 or all 64 bits, ZigZag undone.
template <NumberKind Kind>
constexpr auto fromVarint(std::uint64_t varint) {
  const auto low = static_cast<std::uint32_t>(varint);
  if constexpr (Kind == NumberKind::uint64) {
    return varint;
  } else if constexpr (Kind == NumberKind::uint32) {
    return low;
  } else if constexpr (Kind == NumberKind::sint32) {
    return static_cast<std::int32_t>((low >> 1) ^ (0U - (low & 1)));
  } else if constexpr (Kind == NumberKind::boolean) {
    return varint != 0;
  } else {
    return static_cast<std::int32_t>(low);
  }
}

template <NumberKind Kind, class Stored>
void writeNumber(WireWriter& writer, Stored value, std::uint32_t fieldNumber) {
  if constexpr (Kind == NumberKind::uint64) {
    writer.writeUint64(value, fieldNumber);
  } else if constexpr (Kind == NumberKind::uint32) {
    writer.writeUint32(value, fieldNumber);
  } else if constexpr (Kind == NumberKind::sint32) {
    writer.writeSint32(value, fieldNumber);
  } else if constexpr (Kind == NumberKind::boolean) {
    writer.writeBool(value, fieldNumber);
  } else {
    writer.writeInt32(value, fieldNumber);
  }
}

// Sign-extended for signed kinds, spread over 64 bits by the golden ratio of two to the 32nd.
template <class Stored>
constexpr std::uint64_t hashOfNumber(Stored value) {
  constexpr std::uint64_t multiplier = 2654435761;
  return static_cast<std::uint64_t>(static_cast<std::int64_t>(value)) * multiplier;
}

}  // namespace vespscope
