// A table screen broken into lines of a width: section headers and rows in a label and a value column.
#pragma once

#include <cstddef>
#include <vector>

#include "frontends/terminal/CellText.h"
#include "frontends/terminal/ScreenModel.h"

namespace vespscope::terminal {

struct TableLine {
  enum class Kind { blank, header, row };
  Kind kind = Kind::blank;
  std::size_t section = 0;
  std::size_t row = 0;  // the number of the row, for rows
  bool first = false;   // the row's first line
  GlyphLine label;      // of this line; a header's title
  GlyphLine value;
};

struct TableLines {
  // The columns where labels and values start; before the labels are the marks of the selection and of changes.
  static constexpr int labelColumn = 3;
  int valueColumn = 0;  // on lists, the column of the disclosure mark
  int hang = 0;         // further indent of a value's lines after its first one

  std::vector<TableLine> lines;
  struct Extent {
    int block = 0;  // the first line above the row that belongs to it: its section's header, if it is the first row
    int begin = 0;
    int end = 0;
  };
  std::vector<Extent> rows;  // by row number

  [[nodiscard]] int count() const { return static_cast<int>(lines.size()); }
};

[[nodiscard]] TableLines layOutTable(const ScreenModel& model, int width, bool utf8);

}  // namespace vespscope::terminal
