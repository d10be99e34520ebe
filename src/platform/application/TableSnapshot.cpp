#include "platform/application/TableSnapshot.h"

#include <utility>

namespace vespscope::application {
namespace {

RowSnapshot readRow(TableViewController& screen, IndexPath path) {
  const std::shared_ptr<TableCell> cell = screen.cellForRow(path);
  RowSnapshot row;
  row.label = labelText(*cell).value_or(std::string());
  if (cell->detailTextLabel) row.value = cell->detailTextLabel->text;
  row.disclosure = cell->disclosure;
  return row;
}

}  // namespace

TableSnapshot readTable(TableViewController& screen) {
  TableSnapshot table;
  const std::size_t sections = screen.numberOfSections();
  table.sections.reserve(sections);
  for (std::size_t section = 0; section < sections; ++section) {
    SectionSnapshot snapshot;
    snapshot.title = screen.titleForHeader(section);
    const std::size_t rows = screen.numberOfRows(section);
    snapshot.rows.reserve(rows);
    for (std::size_t row = 0; row < rows; ++row) snapshot.rows.push_back(readRow(screen, {section, row}));
    table.sections.push_back(std::move(snapshot));
  }
  return table;
}

}  // namespace vespscope::application
