// Byte strings in the form of a hex dump, and the frames and records around them.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "sources/diag/FrameReader.h"
#include "values/Value.h"

namespace vespscope::test {

// "7e 01" as its two bytes.
inline Bytes bytesOf(std::string_view dump) {
  Bytes bytes;
  std::string digits;
  for (const char character : dump) {
    if (character == ' ') continue;
    digits += character;
    if (digits.size() < 2) continue;
    bytes.push_back(static_cast<std::uint8_t>(std::stoul(digits, nullptr, 16)));
    digits.clear();
  }
  return bytes;
}

inline void append(Bytes& bytes, const Bytes& more) { bytes.insert(bytes.end(), more.begin(), more.end()); }

// A frame of `content`: with its checksum, escapes and end.
inline Bytes frameOf(Bytes content) {
  const std::uint16_t crc = sources::diag::crc16X25(content);
  content.push_back(static_cast<std::uint8_t>(crc & 0xFF));
  content.push_back(static_cast<std::uint8_t>(crc >> 8));
  Bytes frame;
  for (const std::uint8_t byte : content) {
    if (byte == 0x7E || byte == 0x7D) {
      frame.push_back(0x7D);
      frame.push_back(byte ^ 0x20);
    } else {
      frame.push_back(byte);
    }
  }
  frame.push_back(0x7E);
  return frame;
}

// A log record of `code` at `milliseconds` since 1980-01-06, a multiple of five.
inline Bytes recordOf(std::uint16_t code, std::uint64_t milliseconds, const Bytes& payload) {
  const std::size_t length = payload.size() + 12;
  Bytes record = {0x10, 0x00};
  const auto u16 = [&](std::size_t number) {
    record.push_back(static_cast<std::uint8_t>(number & 0xFF));
    record.push_back(static_cast<std::uint8_t>(number >> 8 & 0xFF));
  };
  u16(length);
  u16(length);
  u16(code);
  const std::uint64_t ticks = milliseconds * 4 / 5;
  u16(0);
  for (unsigned shift = 0; shift < 48; shift += 16) u16(ticks >> shift & 0xFFFF);
  append(record, payload);
  return record;
}

}  // namespace vespscope::test
