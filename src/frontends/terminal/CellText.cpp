#include "frontends/terminal/CellText.h"

#include <algorithm>
#include <iterator>
#include <utility>

#include <wchar.h>

#include "values/Text.h"
#include "values/Utf8.h"

namespace vespscope::terminal {
namespace {

constexpr const char* replacement = "\xEF\xBF\xBD";  // U+FFFD

// Invisible characters that terminals treat differently: joiners, direction marks, variation selectors.
bool isIgnorable(char32_t point) {
  return (point >= 0x200B && point <= 0x200F) || (point >= 0x2060 && point <= 0x206F) || point == 0xFEFF ||
         (point >= 0xFE00 && point <= 0xFE0F) || (point >= 0xE0000 && point <= 0xE0FFF);
}

bool breaksAfter(const Glyph& glyph) {
  const std::string_view bytes = glyph.bytes.view();
  return bytes.size() == 1 && std::string_view("_,;/-").find(bytes[0]) != std::string_view::npos;
}

bool isBlank(const Glyph& glyph) { return glyph.bytes.view() == " "; }

}  // namespace

GlyphLine glyphsOf(std::string_view text, bool utf8) {
  GlyphLine glyphs;
  glyphs.reserve(text.size());
  if (isPlain(text)) {
    for (const char character : text) glyphs.push_back({GlyphBytes(character), 1});
    return glyphs;
  }
  const std::string clean = printable(text);
  std::string_view left = clean;
  std::size_t combining = 0;
  while (!left.empty()) {
    const CodePoint point = codePointAt(left);
    const std::string_view bytes = left.substr(0, point.length);
    left.remove_prefix(point.length);
    if (point.value < 0x80) {
      glyphs.push_back({bytes, 1});
      combining = 0;
    } else if (!utf8) {
      glyphs.push_back({"?", 1});
    } else if (!isIgnorable(point.value)) {
      const int width = ::wcwidth(static_cast<wchar_t>(point.value));
      if (width < 0) {
        glyphs.push_back({replacement, 1});
        combining = 0;
      } else if (width > 0) {
        glyphs.push_back({bytes, static_cast<std::uint8_t>(width)});
        combining = 0;
      } else if (++combining <= GlyphBytes::combiningLimit) {
        if (glyphs.empty()) glyphs.push_back({" ", 1});  // a combining character needs a base character
        glyphs.back().bytes += bytes;
      }
    }
  }
  return glyphs;
}

int widthOf(const GlyphLine& glyphs) {
  int width = 0;
  for (const Glyph& glyph : glyphs) width += glyph.width;
  return width;
}

int widthOf(std::string_view text, bool utf8) {
  return isPlain(text) ? static_cast<int>(text.size()) : widthOf(glyphsOf(text, utf8));
}

GlyphLine elided(GlyphLine glyphs, int width, bool utf8) {
  if (widthOf(glyphs) <= width) return glyphs;
  int left = widthOf(glyphs);
  const int mark = utf8 ? 1 : 2;
  while (!glyphs.empty() && left > width - mark) {
    left -= glyphs.back().width;
    glyphs.pop_back();
  }
  if (width >= mark) {
    for (const Glyph& glyph : glyphsOf(utf8 ? "…" : "..", utf8)) glyphs.push_back(glyph);
  }
  return glyphs;
}

std::vector<GlyphLine> wrapped(GlyphLine glyphs, int first, int rest) {
  std::vector<GlyphLine> lines;
  if (widthOf(glyphs) <= first) {
    lines.push_back(std::move(glyphs));
    return lines;
  }
  auto from = glyphs.begin();
  while (from != glyphs.end()) {
    const int limit = lines.empty() ? first : rest;
    int used = 0;
    auto end = from;
    while (end != glyphs.end() && (used + end->width <= limit || end == from)) used += (end++)->width;
    auto next = end;
    if (end != glyphs.end() && !isBlank(*end)) {
      // The line is full within a word: go back to the last possible break.
      const auto backwards = [&](auto mayEnd) {
        auto place = end;
        while (place != from && !mayEnd(*(place - 1))) --place;
        return place;
      };
      auto place = backwards(isBlank);
      if (place == from || std::all_of(from, place, isBlank)) place = backwards(breaksAfter);
      if (place != from) end = next = place;
    }
    while (next != glyphs.end() && isBlank(*next)) ++next;
    while (end != from && next != glyphs.end() && isBlank(*(end - 1))) --end;
    lines.emplace_back(std::move_iterator(from), std::move_iterator(end));
    from = next;
  }
  if (lines.empty()) lines.emplace_back();
  return lines;
}

void removeLastCharacter(std::string& text) {
  while (!text.empty()) {
    const bool continues = (static_cast<unsigned char>(text.back()) & 0xC0) == 0x80;
    text.pop_back();
    if (!continues) return;
  }
}

}  // namespace vespscope::terminal
