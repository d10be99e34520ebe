#include "values/Text.h"

#include <array>
#include <charconv>
#include <cmath>
#include <type_traits>

namespace vespscope {
namespace {

constexpr std::string_view replacement = "\xEF\xBF\xBD";  // U+FFFD

template <class Number>
void appendFloating(std::string& out, Number number) {
  if (!std::isfinite(number)) {
    out += std::isnan(number) ? "nan" : number < 0 ? "-inf" : "inf";
    return;
  }
  const Number size = std::abs(number);
  const bool plain = size == 0 || (size >= static_cast<Number>(1e-4) && size < static_cast<Number>(1e16));
  std::array<char, 64> buffer;
  const auto result = std::to_chars(buffer.data(), buffer.data() + buffer.size(), number,
                                    plain ? std::chars_format::fixed : std::chars_format::scientific);
  const std::string_view text(buffer.data(), static_cast<std::size_t>(result.ptr - buffer.data()));
  out += text;
  if (plain && text.find('.') == std::string_view::npos) out += ".0";
}

template <class Number>
void appendInteger(std::string& out, Number number) {
  std::array<char, 24> buffer;
  const auto result = std::to_chars(buffer.data(), buffer.data() + buffer.size(), number);
  out.append(buffer.data(), result.ptr);
}

void appendBytes(std::string& out, const Bytes& bytes) {
  constexpr std::string_view digits = "0123456789abcdef";
  out += '<';
  for (std::size_t index = 0; index < bytes.size(); ++index) {
    if (index != 0) out += ' ';
    out += digits[bytes[index] >> 4];
    out += digits[bytes[index] & 15];
  }
  out += '>';
}

// Length of the well-formed UTF-8 sequence at the start of `text` (RFC 3629), 0 when there is none.
std::size_t sequenceLength(std::string_view text) {
  const auto byte = [&text](std::size_t index) { return static_cast<unsigned char>(text[index]); };
  const unsigned char lead = byte(0);
  std::size_t length = 0;
  unsigned char low = 0x80;
  unsigned char high = 0xBF;
  if (lead < 0x80) return 1;
  if (lead >= 0xC2 && lead <= 0xDF) {
    length = 2;
  } else if (lead >= 0xE0 && lead <= 0xEF) {
    length = 3;
    if (lead == 0xE0) low = 0xA0;
    if (lead == 0xED) high = 0x9F;
  } else if (lead >= 0xF0 && lead <= 0xF4) {
    length = 4;
    if (lead == 0xF0) low = 0x90;
    if (lead == 0xF4) high = 0x8F;
  } else {
    return 0;
  }
  if (text.size() < length || byte(1) < low || byte(1) > high) return 0;
  for (std::size_t index = 2; index < length; ++index) {
    if ((byte(index) & 0xC0) != 0x80) return 0;
  }
  return length;
}

// Code points that break or reorder a line: C1 controls, line and paragraph separators, directional overrides.
bool disturbsLine(std::string_view sequence) {
  return (sequence.size() == 2 && sequence[0] == '\xC2' && static_cast<unsigned char>(sequence[1]) < 0xA0) ||
         (sequence.size() == 3 && sequence[0] == '\xE2' && sequence[1] == '\x80' && sequence[2] >= '\xA8' &&
          sequence[2] <= '\xAE') ||
         (sequence.size() == 3 && sequence[0] == '\xE2' && sequence[1] == '\x81' && sequence[2] >= '\xA6' &&
          sequence[2] <= '\xA9');
}

}  // namespace

void appendNumber(std::string& out, float number) { appendFloating(out, number); }
void appendNumber(std::string& out, double number) { appendFloating(out, number); }

void appendPrintable(std::string& out, std::string_view text) {
  while (!text.empty()) {
    const auto lead = static_cast<unsigned char>(text[0]);
    std::size_t length = 1;
    if (lead < 0x20) {
      out += {'\xE2', '\x90', static_cast<char>(0x80 + lead)};
    } else if (lead == 0x7F) {
      out += "\xE2\x90\xA1";
    } else if (lead < 0x7F) {
      out += text[0];
    } else if (const std::size_t sequence = sequenceLength(text); sequence == 0) {
      out += replacement;
    } else {
      length = sequence;
      out += disturbsLine(text.substr(0, sequence)) ? replacement : text.substr(0, sequence);
    }
    text.remove_prefix(length);
  }
}

std::string printable(std::string_view text) {
  std::string out;
  appendPrintable(out, text);
  return out;
}

void appendText(std::string& out, const Value& value) {
  std::visit(
      [&out](const auto& kind) {
        using Kind = std::decay_t<decltype(kind)>;
        if constexpr (std::is_same_v<Kind, std::monostate>) {
          out += "null";
        } else if constexpr (std::is_same_v<Kind, bool>) {
          out += kind ? '1' : '0';
        } else if constexpr (std::is_floating_point_v<Kind>) {
          appendFloating(out, kind);
        } else if constexpr (std::is_integral_v<Kind>) {
          appendInteger(out, kind);
        } else if constexpr (std::is_same_v<Kind, std::string>) {
          appendPrintable(out, kind);
        } else if constexpr (std::is_same_v<Kind, Bytes>) {
          appendBytes(out, kind);
        } else if constexpr (std::is_same_v<Kind, List>) {
          out += '[';
          for (std::size_t index = 0; index < kind.size(); ++index) {
            if (index != 0) out += ", ";
            appendText(out, kind[index]);
          }
          out += ']';
        } else {
          appendText(out, kind);
        }
      },
      value.data());
}

void appendText(std::string& out, const Record& record) {
  out += '[';
  bool first = true;
  for (const Entry& entry : record) {
    if (!first) out += ", ";
    first = false;
    appendPrintable(out, entry.key.view());
    out += ": ";
    appendText(out, entry.value);
  }
  out += ']';
}

std::string toText(const Value& value) {
  std::string out;
  appendText(out, value);
  return out;
}

std::string toText(const Record& record) {
  std::string out;
  appendText(out, record);
  return out;
}

}  // namespace vespscope
