// Code points of well-formed UTF-8, one at a time.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>

namespace vespscope {

struct CodePoint {
  char32_t value;
  std::size_t length;  // in bytes
};

// The code point at the start of `text`, which is not empty and well-formed.
[[nodiscard]] inline CodePoint codePointAt(std::string_view text) {
  const auto byte = [text](std::size_t index) {
    return static_cast<char32_t>(static_cast<unsigned char>(text[index]));
  };
  const char32_t lead = byte(0);
  if (lead < 0x80) return {lead, 1};
  if (lead < 0xE0) return {(lead & 0x1F) << 6 | (byte(1) & 0x3F), 2};
  if (lead < 0xF0) return {(lead & 0x0F) << 12 | (byte(1) & 0x3F) << 6 | (byte(2) & 0x3F), 3};
  return {(lead & 0x07) << 18 | (byte(1) & 0x3F) << 12 | (byte(2) & 0x3F) << 6 | (byte(3) & 0x3F), 4};
}

inline void appendCodePoint(std::string& text, char32_t point) {
  const auto tail = [point](int shift) { return static_cast<char>(0x80 | ((point >> shift) & 0x3F)); };
  if (point < 0x80) {
    text += static_cast<char>(point);
  } else if (point < 0x800) {
    text += {static_cast<char>(0xC0 | point >> 6), tail(0)};
  } else if (point < 0x10000) {
    text += {static_cast<char>(0xE0 | point >> 12), tail(6), tail(0)};
  } else {
    text += {static_cast<char>(0xF0 | point >> 18), tail(12), tail(6), tail(0)};
  }
}

}  // namespace vespscope
