#include "frontends/terminal/ClipboardSequence.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>

namespace vespscope::terminal {
namespace {

std::string base64(std::string_view text) {
  constexpr std::string_view digits = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
  std::string encoded;
  for (std::size_t at = 0; at < text.size(); at += 3) {
    std::uint32_t bits = 0;
    const std::size_t count = std::min<std::size_t>(text.size() - at, 3);
    for (std::size_t index = 0; index < 3; ++index) {
      bits = bits << 8 | (index < count ? static_cast<unsigned char>(text[at + index]) : 0U);
    }
    for (std::size_t digit = 0; digit < 4; ++digit) {
      encoded += digit <= count ? digits[bits >> (18 - 6 * digit) & 63] : '=';
    }
  }
  return encoded;
}

}  // namespace

std::string clipboardSequence(std::string_view text) { return "\x1b]52;c;" + base64(text) + "\x07"; }

}  // namespace vespscope::terminal
