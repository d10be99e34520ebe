// A rectangle of styled character cells: the contents of the terminal.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "frontends/terminal/CellText.h"

namespace vespscope::terminal {

// The meaning of a piece of text; the terminal chooses its look, with or without colours.
enum class Role : std::uint8_t {
  text,
  title,    // the screen shown, at the end of the breadcrumb
  faint,    // rules, hints, the path to the screen
  header,   // of a section
  changed,  // a value that changed at the last reload, and its mark
  live,     // the kinds of sources
  simulated,
  recorded,
  unknownSource,
  warning,  // a loss, a failure or a missing connection
  old,      // values that are out of date
};

struct Style {
  Role role = Role::text;
  bool selected = false;
  friend bool operator==(const Style&, const Style&) = default;
};

struct Cell {
  std::string glyph = " ";  // empty: the second half of the wide glyph to the left
  Style style;
  friend bool operator==(const Cell&, const Cell&) = default;
};

struct Size {
  int width = 0;
  int height = 0;
  friend bool operator==(const Size&, const Size&) = default;
};

class Grid {
 public:
  Grid(Size size, bool utf8);

  [[nodiscard]] Size size() const { return size_; }
  [[nodiscard]] bool utf8() const { return utf8_; }
  [[nodiscard]] const Cell& at(int column, int line) const;

  // Writes from a place rightwards, clipped at the edges; returns the column after the last written cell.
  int put(int column, int line, const GlyphLine& glyphs, Style style = {});
  int put(int column, int line, std::string_view text, Style style = {});
  // Writes a text that ends before `end`; returns the column where it starts.
  int putEndingAt(int end, int line, std::string_view text, Style style = {});
  // Fills cells of one line with a one-cell glyph.
  void fill(int column, int line, int count, std::string_view glyph, Style style = {});
  // Draws a whole line as selected.
  void select(int line);

  // The characters only, with a newline after each line and no trailing blanks.
  [[nodiscard]] std::string text() const;

  friend bool operator==(const Grid&, const Grid&) = default;

 private:
  [[nodiscard]] bool holds(int column, int line) const;
  [[nodiscard]] Cell& cell(int column, int line);

  Size size_;
  bool utf8_;
  std::vector<Cell> cells_;
};

}  // namespace vespscope::terminal
