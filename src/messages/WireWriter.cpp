#include "messages/WireWriter.h"

#include <array>

namespace vespscope {
namespace {

constexpr std::uint64_t lengthDelimited = 2;

using Varint = std::array<std::uint8_t, 10>;

// Fills `out` with groups of seven bits, lowest first, and returns how many bytes they take.
std::size_t encodeVarint(std::uint64_t value, Varint& out) {
  std::size_t size = 0;
  while (value >= 0x80) {
    out[size++] = static_cast<std::uint8_t>(value | 0x80);
    value >>= 7;
  }
  out[size++] = static_cast<std::uint8_t>(value);
  return size;
}

}  // namespace

void WireWriter::appendVarint(std::uint64_t value) {
  if (value < 0x80) {
    buffer_.push_back(static_cast<std::uint8_t>(value));
    return;
  }
  Varint encoded;
  const std::size_t size = encodeVarint(value, encoded);
  buffer_.insert(buffer_.end(), encoded.begin(), encoded.begin() + static_cast<std::ptrdiff_t>(size));
}

void WireWriter::writeVarint(std::uint64_t value, std::uint32_t fieldNumber) {
  if (fieldNumber != noField) appendVarint(std::uint64_t{fieldNumber} << 3);
  appendVarint(value);
}

void WireWriter::appendLengthKey(std::uint32_t fieldNumber) {
  if (fieldNumber != noField) appendVarint(std::uint64_t{fieldNumber} << 3 | lengthDelimited);
}

void WireWriter::writeBytes(std::span<const std::uint8_t> value, std::uint32_t fieldNumber) {
  appendLengthKey(fieldNumber);
  appendVarint(value.size());
  buffer_.insert(buffer_.end(), value.begin(), value.end());
}

void WireWriter::writeString(std::string_view value, std::uint32_t fieldNumber) {
  appendLengthKey(fieldNumber);
  appendVarint(value.size());
  buffer_.insert(buffer_.end(), value.begin(), value.end());
}

WireWriter::Mark WireWriter::placeMark(std::uint32_t fieldNumber) {
  appendLengthKey(fieldNumber);
  buffer_.push_back(0);  // room for the length, one byte in nearly every message
  return {buffer_.size()};
}

void WireWriter::recallMark(Mark mark) {
  Varint encoded;
  const std::size_t size = encodeVarint(buffer_.size() - mark.start, encoded);
  buffer_[mark.start - 1] = encoded[0];
  if (size == 1) return;
  buffer_.insert(buffer_.begin() + static_cast<std::ptrdiff_t>(mark.start), encoded.begin() + 1,
                 encoded.begin() + static_cast<std::ptrdiff_t>(size));
}

}  // namespace vespscope
