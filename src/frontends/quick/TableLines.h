// A table as the flat list of lines that a list view shows: section headers and rows, each with a key by which it is
// known again after the table has been read anew.
#pragma once

#include <QString>
#include <optional>
#include <vector>

#include "platform/application/TableSnapshot.h"
#include "platform/application/TableViewController.h"

namespace vespscope::quick {

// Which line this is, whatever its value: rows of a section are told apart by their label, and those that share a
// label by their order.
struct LineKey {
  std::size_t section = 0;
  bool header = false;
  QString label;
  int occurrence = 0;
  friend bool operator==(const LineKey&, const LineKey&) = default;
};

struct Line {
  LineKey key;
  application::IndexPath path;  // of a row; of a header, the section's first row
  std::optional<QString> value;
  bool disclosure = false;
  bool first = false;     // of the lines shown of its section's rows
  bool last = false;      // likewise
  bool apart = false;     // begins a section without a header below other lines
  bool changed = false;   // since the table was read before
  bool expanded = false;  // shows its text for selection
  bool opened = false;    // led to the next screen
  friend bool operator==(const Line&, const Line&) = default;
};

using Lines = std::vector<Line>;

// All lines of a table, none of them marked.
[[nodiscard]] Lines linesOf(const application::TableSnapshot& table);

// Takes over from `before` what the user did to each line, and marks the rows whose value is another one now or that
// were not there.
void carryOver(const Lines& before, Lines& now);

// The rows whose label, value or section header contains `filter` in any case, under their headers; all lines if it
// is empty. Sets `first`, `last`
// and `apart`.
[[nodiscard]] Lines linesMatching(const Lines& lines, const QString& filter);

// "label: value", or the label alone.
[[nodiscard]] QString textOf(const Line& line);

// Every line as text; an empty line before each header but the first.
[[nodiscard]] QString textOf(const Lines& lines);

}  // namespace vespscope::quick
