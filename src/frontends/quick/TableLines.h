// A table as the flat list of lines that a list view shows: section headers and rows.
#pragma once

#include <QString>
#include <optional>
#include <vector>

#include "platform/application/LiveTable.h"

namespace vespscope::quick {

struct Line {
  bool header = false;
  application::RowIdentity identity;  // for a header: its section and title
  application::IndexPath path;        // for a header: its section's first row
  QString label;
  std::optional<QString> value;
  bool disclosure = false;
  bool first = false;     // of its section's listed rows
  bool last = false;      // same
  bool apart = false;     // begins a section without a header after other lines
  bool changed = false;   // since the previous reading of the table
  bool expanded = false;  // shows its text for selection
  bool opened = false;    // its screen is the next one
  friend bool operator==(const Line&, const Line&) = default;

  [[nodiscard]] bool isSameAs(const Line& other) const { return header == other.header && identity == other.identity; }
};

using Lines = std::vector<Line>;

// Returns the rows that pass the table's filter under their headers, neither expanded nor opened.
[[nodiscard]] Lines linesOf(const application::LiveTable& table);

}  // namespace vespscope::quick
