#include "values/Text.h"

#include <algorithm>
#include <array>
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
// event costs, and most of that was asking the string for each of their pieces anew.
class Pen {
 public:
  explicit Pen(std::string& out) : out_(out), scratch_(threadsOwn()), at_(scratch_.begin()), end_(scratch_.end()) {}
  Pen(const Pen&) = delete;
  Pen& operator=(const Pen&) = delete;
  ~Pen() {
    out_.append(scratch_.begin(), written());
    scratch_.tidy();
  }

  // Where at least `size` characters may be written; taken() says how far that went.
  [[nodiscard, gnu::always_inline]] char* room(std::size_t size) {
    if (static_cast<std::size_t>(end_ - at_) < size) makeRoom(size);
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
  static Scratch& threadsOwn() {
    thread_local Scratch scratch;
    return scratch;
  }
  [[nodiscard]] std::size_t written() { return static_cast<std::size_t>(at_ - scratch_.begin()); }
  [[gnu::noinline]] void makeRoom(std::size_t size) {
    const std::size_t used = written();
    scratch_.grow(used, size);
    at_ = scratch_.begin() + used;
    end_ = scratch_.end();
  }

  std::string& out_;
  Scratch& scratch_;
  char* at_;
  char* end_;
};

// Puts a short literal at `place`; where it ends.
template <std::size_t Size>
[[gnu::always_inline]] inline char* put(char* place, const char (&literal)[Size]) {
  std::memcpy(place, literal, Size - 1);
  return place + Size - 1;
}

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

constexpr std::size_t longestInteger = 20;

// Puts a number at `place`, which has room for the longest; where it ends.
template <class Number>
[[gnu::always_inline]] inline char* putInteger(char* place, Number number) {
  if (number >= 0 && number < 10) {
    *place = static_cast<char>('0' + number);
    return place + 1;
  }
  return std::to_chars(place, place + longestInteger, number).ptr;
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

void writeBytes(Pen& pen, const Bytes& bytes) {
  char* place = pen.room(3 * bytes.size() + 4);
  *place++ = '<';
  for (const std::uint8_t byte : bytes) {
    std::memcpy(place, bytePictures[byte].data(), 4);
    place += 3;
  }
  if (!bytes.empty()) --place;  // no blank after the last
  *place++ = '>';
  pen.taken(place);
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

[[gnu::noinline]] void writeUnplain(Pen& pen, std::string_view text) {
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

void writePrintable(Pen& pen, std::string_view text) {
  char* place = pen.room(text.size());
  if (copyPlain(place, text)) {
    pen.taken(place + text.size());
  } else {
    writeUnplain(pen, text);
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
      pen.taken(putInteger(pen.room(longestInteger), kind));
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
  const Entry* const first = record.begin();
  for (const Entry& entry : record) {
    const std::string_view key = entry.key.view();
    constexpr std::size_t separators = 4;
    char* place = pen.room(key.size() + separators);
    if (&entry != first) place = put(place, ", ");
    if (copyPlain(place, key)) {
      pen.taken(put(place + key.size(), ": "));
    } else {
      pen.taken(place);
      writeUnplain(pen, key);
      pen.write(": ");
    }
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
  if (text.size() < sizeof(std::uint64_t)) return std::all_of(text.begin(), text.end(), isPlainCharacter);
  std::uint64_t bad = 0;
  coverWithWords<std::uint64_t>(
      text, [&](std::size_t position) { bad |= notPlain(load<std::uint64_t>(text.data() + position)); });
  return bad == 0;
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
