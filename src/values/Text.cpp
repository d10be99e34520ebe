#include "values/Text.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <cstring>
#include <type_traits>

namespace vespscope {
namespace {

constexpr std::string_view replacement = "\xEF\xBF\xBD";  // U+FFFD

// Writes at the end of a string, into room made in advance: log lines are a third of what an event costs, and most of
// that was asking the string for each of their pieces anew.
class Pen {
 public:
  explicit Pen(std::string& out) : out_(out) { setRoom(out.size(), roomAtFirst); }
  Pen(const Pen&) = delete;
  Pen& operator=(const Pen&) = delete;
  ~Pen() { out_.resize(written()); }

  // Where at least `size` characters may be written; taken() says how far that went.
  [[nodiscard]] char* room(std::size_t size) {
    if (static_cast<std::size_t>(end_ - at_) < size) setRoom(written(), std::max(size, written()));
    return at_;
  }
  void taken(char* end) { at_ = end; }
  void write(char character) {
    *room(1) = character;
    ++at_;
  }
  void write(std::string_view text) {
    std::memcpy(room(text.size()), text.data(), text.size());
    at_ += text.size();
  }

 private:
  static constexpr std::size_t roomAtFirst = 256;

  [[nodiscard]] std::size_t written() const { return static_cast<std::size_t>(at_ - out_.data()); }
  void setRoom(std::size_t size, std::size_t more) {
    out_.resize(size + more);
    at_ = out_.data() + size;
    end_ = out_.data() + out_.size();
  }

  std::string& out_;
  char* at_ = nullptr;
  char* end_ = nullptr;
};

template <class Number>
void writeFloating(Pen& pen, Number number) {
  if (!std::isfinite(number)) {
    pen.write(std::isnan(number) ? std::string_view("nan") : number < 0 ? "-inf" : "inf");
    return;
  }
  const Number size = std::abs(number);
  const bool plain = size == 0 || (size >= static_cast<Number>(1e-4) && size < static_cast<Number>(1e16));
  std::array<char, 64> buffer;
  const auto result = std::to_chars(buffer.data(), buffer.data() + buffer.size(), number,
                                    plain ? std::chars_format::fixed : std::chars_format::scientific);
  const std::string_view text(buffer.data(), static_cast<std::size_t>(result.ptr - buffer.data()));
  pen.write(text);
  if (plain && text.find('.') == std::string_view::npos) pen.write(".0");
}

template <class Number>
void writeInteger(Pen& pen, Number number) {
  constexpr std::size_t longest = 24;
  char* place = pen.room(longest);
  pen.taken(std::to_chars(place, place + longest, number).ptr);
}

void writeBytes(Pen& pen, const Bytes& bytes) {
  constexpr std::string_view digits = "0123456789abcdef";
  pen.write('<');
  char* place = pen.room(3 * bytes.size());
  for (std::size_t index = 0; index < bytes.size(); ++index) {
    if (index != 0) *place++ = ' ';
    *place++ = digits[bytes[index] >> 4];
    *place++ = digits[bytes[index] & 15];
  }
  pen.taken(place);
  pen.write('>');
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

// True when one of eight characters is not printable ASCII.
bool anyNotPlain(const char* eight) {
  constexpr std::uint64_t ones = 0x0101010101010101;
  constexpr std::uint64_t highs = 0x8080808080808080;
  std::uint64_t bytes = 0;
  std::memcpy(&bytes, eight, sizeof bytes);
  // High bits: of bytes of 0x80 and more, of those below 0x20, and of 0x7F.
  const std::uint64_t low = bytes - ones * 0x20;
  const std::uint64_t deleted = (bytes ^ ones * 0x7F) - ones;
  return ((bytes | low | deleted) & highs) != 0;
}

constexpr bool isPlainCharacter(char character) { return character >= 0x20 && character < 0x7F; }

void writePrintable(Pen& pen, std::string_view text) {
  if (isPlain(text)) return pen.write(text);
  while (!text.empty()) {
    const auto lead = static_cast<unsigned char>(text[0]);
    std::size_t length = 1;
    if (lead < 0x20) {
      pen.write("\xE2\x90");
      pen.write(static_cast<char>(0x80 + lead));
    } else if (lead == 0x7F) {
      pen.write("\xE2\x90\xA1");
    } else if (lead < 0x7F) {
      pen.write(text[0]);
    } else if (const std::size_t sequence = sequenceLength(text); sequence == 0) {
      pen.write(replacement);
    } else {
      length = sequence;
      pen.write(disturbsLine(text.substr(0, sequence)) ? replacement : text.substr(0, sequence));
    }
    text.remove_prefix(length);
  }
}

void write(Pen& pen, const Record& record);

void write(Pen& pen, const Value& value) {
  value.visit([&pen](const auto& kind) {
    using Kind = std::decay_t<decltype(kind)>;
    if constexpr (std::is_same_v<Kind, std::monostate>) {
      pen.write("null");
    } else if constexpr (std::is_same_v<Kind, bool>) {
      pen.write(kind ? '1' : '0');
    } else if constexpr (std::is_floating_point_v<Kind>) {
      writeFloating(pen, kind);
    } else if constexpr (std::is_integral_v<Kind>) {
      writeInteger(pen, kind);
    } else if constexpr (std::is_same_v<Kind, std::string_view>) {
      writePrintable(pen, kind);
    } else if constexpr (std::is_same_v<Kind, Bytes>) {
      writeBytes(pen, kind);
    } else if constexpr (std::is_same_v<Kind, List>) {
      pen.write('[');
      for (std::size_t index = 0; index < kind.size(); ++index) {
        if (index != 0) pen.write(", ");
        write(pen, kind[index]);
      }
      pen.write(']');
    } else {
      write(pen, kind);
    }
  });
}

void write(Pen& pen, const Record& record) {
  pen.write('[');
  bool first = true;
  for (const Entry& entry : record) {
    if (!first) pen.write(", ");
    first = false;
    writePrintable(pen, entry.key.view());
    pen.write(": ");
    write(pen, entry.value);
  }
  pen.write(']');
}

template <class Content>
void append(std::string& out, void (*writeContent)(Pen&, Content), Content content) {
  Pen pen(out);
  writeContent(pen, content);
}

}  // namespace

bool isPlain(std::string_view text) {
  if (text.size() < 8) return std::all_of(text.begin(), text.end(), isPlainCharacter);
  std::size_t position = 0;
  for (; position + 8 <= text.size(); position += 8) {
    if (anyNotPlain(text.data() + position)) return false;
  }
  return !anyNotPlain(text.data() + text.size() - 8);
}

void appendNumber(std::string& out, float number) { append(out, &writeFloating<float>, number); }
void appendNumber(std::string& out, double number) { append(out, &writeFloating<double>, number); }
void appendPrintable(std::string& out, std::string_view text) { append(out, &writePrintable, text); }
void appendText(std::string& out, const Value& value) { append<const Value&>(out, &write, value); }
void appendText(std::string& out, const Record& record) { append<const Record&>(out, &write, record); }

std::string printable(std::string_view text) {
  std::string out;
  appendPrintable(out, text);
  return out;
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
