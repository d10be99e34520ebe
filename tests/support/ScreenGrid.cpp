#include "support/ScreenGrid.h"

#include <algorithm>

#include "platform/application/TableSnapshot.h"

namespace vespscope::test {

std::string gridOf(application::TableViewController& screen) {
  const application::TableSnapshot table = application::readTable(screen);
  std::size_t width = 0;
  for (const auto& section : table.sections) {
    for (const auto& row : section.rows) width = std::max(width, row.label.size());
  }
  std::string grid;
  if (table.sections.empty()) grid = "(no sections)\n";
  for (const auto& section : table.sections) {
    if (section.title) {
      grid += "-- " + *section.title + " --\n";
    } else if (&section != &table.sections.front()) {
      grid += "--\n";
    }
    if (section.rows.empty()) grid += "(no rows)\n";
    for (const auto& row : section.rows) {
      std::string line = row.label;
      if (row.value) {
        line.resize(width + 2, ' ');
        line += *row.value;
      }
      if (row.disclosure) line += "  >";
      line.erase(line.find_last_not_of(' ') + 1);
      grid += line + '\n';
    }
  }
  return grid;
}

}  // namespace vespscope::test
