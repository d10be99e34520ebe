#include "frontends/terminal/Grid.h"

#include <algorithm>

namespace vespscope::terminal {

Grid::Grid(Size size, bool utf8)
    : size_{std::max(size.width, 0), std::max(size.height, 0)},
      utf8_(utf8),
      cells_(static_cast<std::size_t>(size_.width) * static_cast<std::size_t>(size_.height)) {}

bool Grid::holds(int column, int line) const {
  return column >= 0 && column < size_.width && line >= 0 && line < size_.height;
}

Cell& Grid::cell(int column, int line) {
  return cells_.at(static_cast<std::size_t>(line) * static_cast<std::size_t>(size_.width) +
                   static_cast<std::size_t>(column));
}

const Cell& Grid::at(int column, int line) const { return const_cast<Grid*>(this)->cell(column, line); }

int Grid::put(int column, int line, const GlyphLine& glyphs, Style style) {
  for (const Glyph& glyph : glyphs) {
    const int last = column + glyph.width - 1;
    if (holds(column, line) && holds(last, line)) {
      cell(column, line) = {std::string(glyph.bytes.view()), style};
      if (glyph.width == 2) cell(last, line) = {"", style};
    }
    column += glyph.width;
  }
  return column;
}

int Grid::put(int column, int line, std::string_view text, Style style) {
  return put(column, line, glyphsOf(text, utf8_), style);
}

int Grid::putEndingAt(int end, int line, std::string_view text, Style style) {
  const GlyphLine glyphs = glyphsOf(text, utf8_);
  const int start = end - widthOf(glyphs);
  put(start, line, glyphs, style);
  return start;
}

void Grid::fill(int column, int line, int count, std::string_view glyph, Style style) {
  for (int step = 0; step < count; ++step) {
    if (holds(column + step, line)) cell(column + step, line) = {std::string(glyph), style};
  }
}

void Grid::select(int line) {
  for (int column = 0; column < size_.width; ++column) {
    if (holds(column, line)) cell(column, line).style.selected = true;
  }
}

std::string Grid::text() const {
  std::string out;
  for (int line = 0; line < size_.height; ++line) {
    std::string row;
    for (int column = 0; column < size_.width; ++column) row += at(column, line).glyph;
    row.erase(row.find_last_not_of(' ') + 1);
    out += row + '\n';
  }
  return out;
}

}  // namespace vespscope::terminal
