#include "sources/diag/FrameReader.h"

#include <array>

namespace vespscope::sources::diag {
namespace {

constexpr std::uint8_t frameEnd = 0x7E;
constexpr std::uint8_t escape = 0x7D;
constexpr std::uint8_t escapeMask = 0x20;
constexpr std::size_t checksumLength = 2;

// Polynomial x^16 + x^12 + x^5 + 1, lowest bit first.
constexpr std::array<std::uint16_t, 256> crcTable = [] {
  std::array<std::uint16_t, 256> table{};
  for (unsigned index = 0; index < table.size(); ++index) {
    unsigned value = index;
    for (int bit = 0; bit < 8; ++bit) value = (value & 1) != 0 ? value >> 1 ^ 0x8408U : value >> 1;
    table[index] = static_cast<std::uint16_t>(value);
  }
  return table;
}();

}  // namespace

std::uint16_t crc16X25(std::span<const std::uint8_t> bytes) {
  std::uint16_t crc = 0xFFFF;
  for (const std::uint8_t byte : bytes) {
    crc = static_cast<std::uint16_t>(crc >> 8 ^ crcTable[(crc ^ byte) & 0xFFU]);
  }
  return static_cast<std::uint16_t>(~crc);
}

std::optional<std::span<const std::uint8_t>> FrameReader::next() {
  while (!piece_.empty()) {
    const std::uint8_t byte = piece_.front();
    piece_ = piece_.subspan(1);
    if (byte != frameEnd) {
      take(byte);
      continue;
    }
    const bool good = frameIsGood();
    if (good) {
      finished_.swap(frame_);
      finished_.resize(finished_.size() - checksumLength);
    }
    beginFrame();
    if (good) return std::span<const std::uint8_t>(finished_);
  }
  return std::nullopt;
}

void FrameReader::finish() {
  if (!frame_.empty() || escaped_ || overflowed_) ++counters_.truncated;
  beginFrame();
}

void FrameReader::take(std::uint8_t byte) {
  if (escaped_) {
    escaped_ = false;
    byte ^= escapeMask;
  } else if (byte == escape) {
    escaped_ = true;
    return;
  }
  if (frame_.size() < maximumFrameLength) {
    frame_.push_back(byte);
  } else {
    overflowed_ = true;
  }
}

bool FrameReader::frameIsGood() {
  if (escaped_) {
    ++counters_.aborted;
    return false;
  }
  if (overflowed_) {
    ++counters_.oversized;
    return false;
  }
  if (frame_.empty()) return false;  // a frame between two ends in a row is empty
  const auto bytes = std::span<const std::uint8_t>(frame_);
  if (frame_.size() > checksumLength) {
    const std::size_t length = frame_.size() - checksumLength;
    const auto told = static_cast<std::uint16_t>(frame_[length] | frame_[length + 1] << 8);
    if (told == crc16X25(bytes.first(length))) {
      ++counters_.good;
      return true;
    }
  }
  ++counters_.badChecksum;
  return false;
}

void FrameReader::beginFrame() {
  frame_.clear();
  escaped_ = false;
  overflowed_ = false;
}

}  // namespace vespscope::sources::diag
