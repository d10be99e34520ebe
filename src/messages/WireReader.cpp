#include "messages/WireReader.h"

#include <array>

namespace vespscope {

std::uint64_t WireReader::readLongVarint() noexcept {
  constexpr unsigned maximumBytes = 10;
  std::uint64_t value = 0;
  for (unsigned index = 0; index < maximumBytes; ++index) {
    if (position_ >= length_) {
      failed_ = true;
      return 0;
    }
    const std::uint8_t byte = data_[position_++];
    value |= static_cast<std::uint64_t>(byte & 0x7F) << (7 * index);
    if (byte < 0x80) return value;
  }
  return 0;
}

bool WireReader::skipBytes(std::uint64_t count) noexcept {
  if (failed_ || count > length_ - position_) {
    failed_ = true;
    return false;
  }
  position_ += static_cast<std::size_t>(count);
  return true;
}

std::optional<std::span<const std::uint8_t>> WireReader::readDelimited() noexcept {
  const std::uint64_t size = readVarint();
  const std::size_t start = position_;
  if (!skipBytes(size)) return std::nullopt;
  return std::span(data_ + start, static_cast<std::size_t>(size));
}

std::optional<WireReader::Mark> WireReader::placeMark() noexcept {
  const std::uint64_t size = readVarint();
  if (failed_ || size > length_ - position_) {
    failed_ = true;
    return std::nullopt;
  }
  const Mark mark{position_ + static_cast<std::size_t>(size), length_};
  length_ = mark.valueEnd;
  return mark;
}

void WireReader::recallMark(const Mark& mark) noexcept {
  position_ = mark.valueEnd;
  length_ = mark.outerLength;
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
