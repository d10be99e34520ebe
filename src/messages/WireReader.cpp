#include "messages/WireReader.h"

#include <array>
#include <bit>
#include <cstring>

namespace vespscope {

WireReader::LongVarint WireReader::readLongVarint(const std::uint8_t* at, const std::uint8_t* end,
                                                  const std::uint8_t* bufferEnd) noexcept {
  // Up to eight bytes at once, in the order of memory: the first byte whose high bit is clear is the last.
  if constexpr (std::endian::native == std::endian::little) {
    if (bufferEnd - at >= 8) {
      std::uint64_t bytes = 0;
      std::memcpy(&bytes, at, sizeof bytes);
      const std::uint64_t ends = ~bytes & 0x8080808080808080;
      if (ends != 0) {
        const int size = std::countr_zero(ends) / 8 + 1;
        if (size > end - at) return {0, nullptr};
        bytes &= ends ^ (ends - 1);  // up to the first end
        // Groups of seven bits move together in pairs, fours and eights.
        bytes = (bytes & 0x007F007F007F007F) | (bytes & 0x7F007F007F007F00) >> 1;
        bytes = (bytes & 0x00003FFF00003FFF) | (bytes & 0x3FFF00003FFF0000) >> 2;
        bytes = (bytes & 0x000000000FFFFFFF) | (bytes & 0x0FFFFFFF00000000) >> 4;
        return {bytes, at + size};
      }
    }
  }
  constexpr unsigned maximumBytes = 10;
  std::uint64_t value = 0;
  for (unsigned index = 0; index < maximumBytes; ++index) {
    if (at >= end) return {0, nullptr};
    const std::uint8_t byte = *at++;
    value |= static_cast<std::uint64_t>(byte & 0x7F) << (7 * index);
    if (byte < 0x80) return {value, at};
  }
  return {0, at};
}

std::optional<WireReader::Mark> WireReader::placeMark() noexcept {
  const std::uint64_t size = readVarint();
  if (failed_ || size > static_cast<std::uint64_t>(end_ - at_)) {
    failed_ = true;
    return std::nullopt;
  }
  const Mark mark{at_ + size, end_};
  end_ = mark.valueEnd;
  return mark;
}

void WireReader::recallMark(const Mark& mark) noexcept {
  at_ = mark.valueEnd;
  end_ = mark.outerEnd;
}

bool WireReader::skipPlain(WireType wireType) noexcept {
  switch (wireType) {
    case WireType::varint:
      readVarint();
      return !failed_;
    case WireType::fixed64:
      return skipBytes(8);
    case WireType::lengthDelimited:
      return skipBytes(readVarint());
    case WireType::fixed32:
      return skipBytes(4);
    default:
      return false;
  }
}

bool WireReader::skipGroup(std::uint16_t fieldNumber) noexcept {
  std::array<std::uint16_t, maximumGroupDepth> open{};
  std::size_t depth = 0;
  open[depth++] = fieldNumber;
  while (depth > 0) {
    const WireKey key(readVarint());
    if (failed_) return false;
    if (key.wireType == WireType::startGroup) {
      if (depth == open.size()) return false;
      open[depth++] = key.fieldNumber;
    } else if (key.wireType == WireType::endGroup) {
      if (open[--depth] != key.fieldNumber) return false;
    } else if (!skipPlain(key.wireType)) {
      return false;
    }
  }
  return true;
}

bool WireReader::skip(WireKey key) noexcept {
  return key.wireType == WireType::startGroup ? skipGroup(key.fieldNumber) : skipPlain(key.wireType);
}

}  // namespace vespscope
