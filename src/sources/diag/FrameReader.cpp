#include "sources/diag/FrameReader.h"

#include <algorithm>
#include <array>
#include <cstring>

namespace vespscope::sources::diag {
namespace {

constexpr std::uint8_t frameEnd = 0x7E;
constexpr std::uint8_t escape = 0x7D;
constexpr std::uint8_t escapeMask = 0x20;
constexpr std::size_t checksumLength = 2;

// Eight bytes are checked at once: the table of a byte by how many bytes follow it among the eight.
constexpr std::size_t slices = 8;
using CrcTable = std::array<std::uint16_t, 256>;

// Polynomial x^16 + x^12 + x^5 + 1, lowest bit first.
constexpr std::array<CrcTable, slices> crcTables = [] {
  std::array<CrcTable, slices> tables{};
  for (unsigned index = 0; index < 256; ++index) {
    unsigned value = index;
    for (int bit = 0; bit < 8; ++bit) value = (value & 1) != 0 ? value >> 1 ^ 0x8408U : value >> 1;
    tables[0][index] = static_cast<std::uint16_t>(value);
  }
  for (std::size_t slice = 1; slice < slices; ++slice) {
    for (unsigned index = 0; index < 256; ++index) {
      const unsigned before = tables[slice - 1][index];
      tables[slice][index] = static_cast<std::uint16_t>(before >> 8 ^ tables[0][before & 0xFFU]);
    }
  }
  return tables;
}();

// The number of bytes before the next frame end or escape.
std::size_t plainBytes(std::span<const std::uint8_t> bytes) {
  constexpr std::uint64_t ones = 0x0101'0101'0101'0101;
  constexpr std::uint64_t highest = 0x8080'8080'8080'8080;
  // Whether a byte of the eight is zero.
  const auto hasZero = [](std::uint64_t eight) { return ((eight - ones) & ~eight & highest) != 0; };
  std::size_t count = 0;
  for (; count + slices <= bytes.size(); count += slices) {
    std::uint64_t eight = 0;
    std::memcpy(&eight, &bytes[count], sizeof eight);
    if (hasZero(eight ^ frameEnd * ones) || hasZero(eight ^ escape * ones)) break;
  }
  while (count < bytes.size() && bytes[count] != frameEnd && bytes[count] != escape) ++count;
  return count;
}

}  // namespace

std::uint16_t crc16X25(std::span<const std::uint8_t> bytes) {
  unsigned crc = 0xFFFF;
  while (bytes.size() >= slices) {
    unsigned next = crcTables[7][(crc ^ bytes[0]) & 0xFFU] ^ crcTables[6][(crc >> 8 ^ bytes[1]) & 0xFFU];
    for (std::size_t i = 2; i < slices; ++i) next ^= crcTables[slices - 1 - i][bytes[i]];
    crc = next;
    bytes = bytes.subspan(slices);
  }
  for (const std::uint8_t byte : bytes) crc = crc >> 8 ^ crcTables[0][(crc ^ byte) & 0xFFU];
  return static_cast<std::uint16_t>(~crc);
}

std::optional<std::span<const std::uint8_t>> FrameReader::next() {
  while (!piece_.empty()) {
    if (const std::size_t plain = escaped_ ? 0 : plainBytes(piece_); plain > 0) {
      const auto fitting = piece_.first(std::min(plain, maximumFrameLength - frame_.size()));
      frame_.insert(frame_.end(), fitting.begin(), fitting.end());
      overflowed_ = overflowed_ || fitting.size() < plain;
      piece_ = piece_.subspan(plain);
      continue;
    }
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
