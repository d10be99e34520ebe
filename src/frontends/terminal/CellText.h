// Text as a terminal shows it: glyphs with their width in cells, and text broken into lines of a width.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace vespscope::terminal {

// The UTF-8 of one base character and of the few combining ones that a terminal's cell can hold. Stored in place: a
// whole screen has tens of thousands.
class GlyphBytes {
 public:
  static constexpr std::size_t combiningLimit = 4;

  // At most one character.
  GlyphBytes(std::string_view character) { *this += character; }
  GlyphBytes(const char* character) : GlyphBytes(std::string_view(character)) {}
  explicit GlyphBytes(char character) : size_(1) { bytes_[0] = character; }

  // Adds a combining character, up to the limit.
  GlyphBytes& operator+=(std::string_view character) {
    size_ = static_cast<std::uint8_t>(size_ + character.copy(bytes_.data() + size_, bytes_.size() - size_));
    return *this;
  }
  [[nodiscard]] std::string_view view() const { return {bytes_.data(), size_}; }

 private:
  static constexpr std::size_t longestCharacter = 4;

  std::array<char, longestCharacter*(1 + combiningLimit)> bytes_;
  std::uint8_t size_ = 0;
};

// One base character with the combining characters that follow it.
struct Glyph {
  GlyphBytes bytes;
  std::uint8_t width = 1;  // cells, 1 or 2
};

using GlyphLine = std::vector<Glyph>;

// Returns the glyphs of any text, made printable first, so that no control character reaches the terminal. Without
// `utf8` every character outside ASCII becomes a question mark. The width of a character is that of the C library
// (`wcwidth`), so the program's locale must be a UTF-8 one when `utf8` is set.
[[nodiscard]] GlyphLine glyphsOf(std::string_view text, bool utf8);

[[nodiscard]] int widthOf(const GlyphLine& glyphs);
[[nodiscard]] int widthOf(std::string_view text, bool utf8);

// Cuts the text to at most `width` cells; a cut text ends with an ellipsis.
[[nodiscard]] GlyphLine elided(GlyphLine glyphs, int width, bool utf8);

// Breaks the text into lines of at most `first` cells, then `rest` cells (both at least 2, the widest glyph). Breaks
// are at blanks if possible, else after `_ , ; / -`, else anywhere; only the blanks at a break are left out. Returns at
// least one line.
[[nodiscard]] std::vector<GlyphLine> wrapped(GlyphLine glyphs, int first, int rest);

// Removes the last character of UTF-8 text.
void removeLastCharacter(std::string& text);

}  // namespace vespscope::terminal
