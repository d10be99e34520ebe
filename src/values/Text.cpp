#include "values/Text.h"

#include <algorithm>
#include <array>
#include <bit>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <cstring>
#include <memory>
#include <type_traits>

namespace vespscope {
namespace {

constexpr std::string_view replacement = "\xEF\xBF\xBD";  // U+FFFD

// Where a text grows before it becomes part of a string: one for each thread, kept for the next text. A string would
// have to fill all the room it is asked for in advance.
class Scratch {
 public:
  Scratch() : memory_(std::make_unique_for_overwrite<char[]>(usual)) {}

  [[nodiscard, gnu::returns_nonnull]] char* begin() { return memory_.get(); }
  [[nodiscard]] char* end() { return memory_.get() + size_; }
  // At least twice the room that there was, with the first `used` characters as they are.
  void grow(std::size_t used, std::size_t needed) {
    const std::size_t size = std::max(2 * size_, used + needed);
    auto memory = std::make_unique_for_overwrite<char[]>(size);
    std::memcpy(memory.get(), memory_.get(), used);
    memory_ = std::move(memory);
    size_ = size;
  }
  // Room for an uncommonly long text is given back.
  void tidy() {
    if (size_ > longestKept) *this = Scratch();
  }

 private:
  static constexpr std::size_t usual = 4096;
  static constexpr std::size_t longestKept = std::size_t{1} << 18;

  std::unique_ptr<char[]> memory_;
  std::size_t size_ = usual;
};

// Writes a text into the thread's scratch memory and adds it to a string in the end: log lines are a third of what an
// event costs, and most of that was asking the string again for each of their pieces. Where the text has come to is
// handed from piece to piece, so that it stays in a register.
class Pen {
 public:
  explicit Pen(std::string& out) : out_(out), scratch_(threadsOwn()), end_(scratch_.end()) {}
  Pen(const Pen&) = delete;
  Pen& operator=(const Pen&) = delete;
  ~Pen() = default;

  [[nodiscard]] char* begin() { return scratch_.begin(); }
  void finish(const char* place) {
    out_.append(static_cast<const char*>(scratch_.begin()), place);
    scratch_.tidy();
  }

  // `place`, which may have moved, with room for at least `size` characters.
  [[nodiscard, gnu::always_inline]] char* room(char* place, std::size_t size) {
    if (static_cast<std::size_t>(end_ - place) < size) [[unlikely]]
      return makeRoom(place, size);
    return place;
  }
  // The end of the written text.
  [[nodiscard]] char* write(char* place, char character) {
    place = room(place, 1);
    *place = character;
    return place + 1;
  }
  [[nodiscard]] char* write(char* place, std::string_view text) {
    place = room(place, text.size());
    std::memcpy(place, text.data(), text.size());
    return place + text.size();
  }

 private:
  static Scratch& threadsOwn() {
    thread_local Scratch scratch;
    return scratch;
  }
  [[gnu::noinline]] char* makeRoom(const char* place, std::size_t size) {
    const auto used = static_cast<std::size_t>(place - scratch_.begin());
    scratch_.grow(used, size);
    end_ = scratch_.end();
    return scratch_.begin() + used;
  }

  std::string& out_;
  Scratch& scratch_;
  char* end_;
};

// Puts a short literal at `place`; where it ends.
template <std::size_t Size>
[[gnu::always_inline]] inline char* put(char* place, const char (&literal)[Size]) {
  std::memcpy(place, literal, Size - 1);
  return place + Size - 1;
}

template <class Number>
char* writeFloating(Pen& pen, char* place, Number number) {
  if (!std::isfinite(number)) {
    return pen.write(place, std::isnan(number) ? std::string_view("nan") : number < 0 ? "-inf" : "inf");
  }
  const Number size = std::abs(number);
  const bool plain = size == 0 || (size >= static_cast<Number>(1e-4) && size < static_cast<Number>(1e16));
  std::array<char, 64> buffer;
  const auto result = std::to_chars(buffer.data(), buffer.data() + buffer.size(), number,
                                    plain ? std::chars_format::fixed : std::chars_format::scientific);
  const std::string_view text(buffer.data(), static_cast<std::size_t>(result.ptr - buffer.data()));
  place = pen.write(place, text);
  return plain && text.find('.') == std::string_view::npos ? pen.write(place, ".0") : place;
}

// The eight digits of a number below a hundred million, the first one in the lowest byte. Without a branch: how many
// digits a number has cannot be foreseen.
constexpr std::uint64_t eightDigits(std::uint64_t number) {
  // Halves, quarters, then single digits, all of one size at once.
  const std::uint64_t halves = number / 10'000 | number % 10'000 << 32;
  const std::uint64_t hundreds = (halves * 10'486 >> 20) & 0x0000'007F'0000'007F;  // divided by 100
  const std::uint64_t quarters = hundreds | (halves - 100 * hundreds) << 16;
  const std::uint64_t tens = (quarters * 103 >> 10) & 0x000F'000F'000F'000F;  // divided by 10
  return tens | (quarters - 10 * tens) << 8;
}
static_assert(eightDigits(12'345'678) == 0x0807'0605'0403'0201);
static_assert(eightDigits(99'999'999) == 0x0909'0909'0909'0909);

// What the longest number takes, and no less than what is written at once.
constexpr std::size_t integerRoom = 1 + 20;

// Puts a number at `place`, which has that room; where it ends.
[[gnu::always_inline]] inline char* putInteger(char* place, Integer number) {
  *place = '-';
  place += number.negative ? 1 : 0;
  if (number.magnitude >= 100'000'000) [[unlikely]] {
    return std::to_chars(place, place + integerRoom - 1, number.magnitude).ptr;
  }
  const std::uint64_t digits = eightDigits(number.magnitude);
  constexpr std::uint64_t lastDigit = std::uint64_t{1} << 56;
  const int leadingZeros = std::countr_zero(digits | lastDigit) / 8;
  // The first digit is to stand first in memory.
  const std::uint64_t text = (digits | 0x3030'3030'3030'3030) >> (8 * leadingZeros);
  if constexpr (std::endian::native == std::endian::little) {
    std::memcpy(place, &text, sizeof text);
  } else {
    for (std::size_t index = 0; index < sizeof text; ++index) place[index] = static_cast<char>(text >> 8 * index);
  }
  return place + 8 - leadingZeros;
}

// Each byte as its two digits and a blank; a fourth character, so that they are copied at once.
constexpr auto bytePictures = [] {
  constexpr std::string_view digits = "0123456789abcdef";
  std::array<std::array<char, 4>, 256> pictures{};
  for (std::size_t byte = 0; byte < pictures.size(); ++byte) {
    pictures[byte] = {digits[byte >> 4], digits[byte & 15], ' ', ' '};
  }
  return pictures;
}();

char* writeBytes(Pen& pen, char* place, const Bytes& bytes) {
  place = pen.room(place, 3 * bytes.size() + 4);
  *place++ = '<';
  for (const std::uint8_t byte : bytes) {
    std::memcpy(place, bytePictures[byte].data(), 4);
    place += 3;
  }
  if (!bytes.empty()) --place;  // no blank after the last
  *place++ = '>';
  return place;
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

constexpr bool isPlainCharacter(char character) { return character >= 0x20 && character < 0x7F; }

template <class Word>
[[gnu::always_inline]] inline Word load(const char* from) {
  Word word;
  std::memcpy(&word, from, sizeof word);
  return word;
}

// Not zero when one of the word's characters is not printable ASCII.
template <class Word>
[[gnu::always_inline]] constexpr Word notPlain(Word word) {
  constexpr Word ones = static_cast<Word>(0x0101010101010101);
  // High bits: of bytes of 0x80 and more, of those below 0x20, and of 0x7F.
  return (word | (word - ones * 0x20) | ((word ^ ones * 0x7F) - ones)) & ones * 0x80;
}

// Calls `word` with pieces of one size that together cover the text, from left to right, the last two of them maybe
// overlapping. For texts of at least that size.
template <class Word, class Visitor>
[[gnu::always_inline]] inline void coverWithWords(std::string_view text, Visitor&& word) {
  std::size_t position = 0;
  for (; position + sizeof(Word) < text.size(); position += sizeof(Word)) word(position);
  word(text.size() - sizeof(Word));
}

// Copies `text` to `place` as it is; false when it is not plain, and then what was copied is not to be used.
[[gnu::always_inline]] inline bool copyPlain(char* place, std::string_view text) {
  const auto copy = [ place, text ]<class Word>(Word bad) __attribute__((always_inline)) {
    coverWithWords<Word>(
        text, [&](std::size_t position) __attribute__((always_inline)) {
          const Word word = load<Word>(text.data() + position);
          std::memcpy(place + position, &word, sizeof word);
          bad |= notPlain(word);
        });
    return bad == 0;
  };
  if (text.size() >= sizeof(std::uint64_t)) return copy(std::uint64_t{0});
  if (text.size() >= sizeof(std::uint32_t)) return copy(std::uint32_t{0});
  bool plain = true;
  for (std::size_t index = 0; index < text.size(); ++index) {
    place[index] = text[index];
    plain = plain && isPlainCharacter(text[index]);
  }
  return plain;
}

[[gnu::noinline]] char* writeUnplain(Pen& pen, char* place, std::string_view text) {
  while (!text.empty()) {
    const auto lead = static_cast<unsigned char>(text[0]);
    std::size_t length = 1;
    if (lead < 0x20) {
      place = pen.write(place, "\xE2\x90");
      place = pen.write(place, static_cast<char>(0x80 + lead));
    } else if (lead == 0x7F) {
      place = pen.write(place, "\xE2\x90\xA1");
    } else if (lead < 0x7F) {
      place = pen.write(place, text[0]);
    } else if (const std::size_t sequence = sequenceLength(text); sequence == 0) {
      place = pen.write(place, replacement);
    } else {
      length = sequence;
      place = pen.write(place, disturbsLine(text.substr(0, sequence)) ? replacement : text.substr(0, sequence));
    }
    text.remove_prefix(length);
  }
  return place;
}

char* writePrintable(Pen& pen, char* place, std::string_view text) {
  place = pen.room(place, text.size());
  return copyPlain(place, text) ? place + text.size() : writeUnplain(pen, place, text);
}

char* write(Pen& pen, char* place, const Record& record);

char* write(Pen& pen, char* place, const Value& value) {
  if (value.isInteger()) return putInteger(pen.room(place, integerRoom), value.integer());
  return value.visit([&pen, place](const auto& kind) -> char* {
    using Kind = std::decay_t<decltype(kind)>;
    if constexpr (std::is_same_v<Kind, std::monostate>) {
      return pen.write(place, "null");
    } else if constexpr (std::is_same_v<Kind, bool>) {
      return pen.write(place, kind ? '1' : '0');
    } else if constexpr (std::is_floating_point_v<Kind>) {
      return writeFloating(pen, place, kind);
    } else if constexpr (std::is_integral_v<Kind>) {
      return place;  // written above
    } else if constexpr (std::is_same_v<Kind, std::string_view>) {
      return writePrintable(pen, place, kind);
    } else if constexpr (std::is_same_v<Kind, Bytes>) {
      return writeBytes(pen, place, kind);
    } else if constexpr (std::is_same_v<Kind, List>) {
      char* end = pen.write(place, '[');
      for (std::size_t index = 0; index < kind.size(); ++index) {
        if (index != 0) end = pen.write(end, ", ");
        end = write(pen, end, kind[index]);
      }
      return pen.write(end, ']');
    } else {
      return write(pen, place, kind);
    }
  });
}

char* write(Pen& pen, char* place, const Record& record) {
  place = pen.write(place, '[');
  const Entry* const first = record.begin();
  for (const Entry& entry : record) {
    const std::string_view key = entry.key.view();
    constexpr std::size_t separators = 4;
    place = pen.room(place, key.size() + separators + integerRoom);
    if (&entry != first) place = put(place, ", ");
    if (copyPlain(place, key)) {
      place = put(place + key.size(), ": ");
    } else {
      place = pen.write(writeUnplain(pen, place, key), ": ");
      place = pen.room(place, integerRoom);
    }
    place = entry.value.isInteger() ? putInteger(place, entry.value.integer()) : write(pen, place, entry.value);
  }
  return pen.write(place, ']');
}

template <class Content>
void append(std::string& out, char* (*writeContent)(Pen&, char*, Content), Content content) {
  Pen pen(out);
  pen.finish(writeContent(pen, pen.begin(), content));
}

}  // namespace

bool isPlain(std::string_view text) {
  // Sixteen characters at a time, the last of them maybe twice.
  using Block [[gnu::vector_size(16)]] = unsigned char;
  if (text.size() < sizeof(Block)) return std::all_of(text.begin(), text.end(), isPlainCharacter);
  Block most{};
  coverWithWords<Block>(text, [&](std::size_t position) {
    const Block distances = load<Block>(text.data() + position) - 0x20;
    most = distances > most ? distances : most;
  });
  std::uint8_t greatest = 0;
  for (std::size_t index = 0; index < sizeof(Block); ++index) greatest = std::max(greatest, most[index]);
  return greatest < 0x7F - 0x20;
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
