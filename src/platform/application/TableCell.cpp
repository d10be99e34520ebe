#include "platform/application/TableCell.h"

namespace vespscope::application {

std::shared_ptr<TableCell> makeCell(const CellPrototype& prototype) {
  auto cell = std::make_shared<TableCell>();
  cell->reuseIdentifier = prototype.identifier;
  cell->style = prototype.style;
  cell->disclosure = prototype.disclosure;
  cell->segueTo = prototype.segueTo;
  cell->textLabel = Label{};
  if (prototype.style == CellStyle::value) cell->detailTextLabel = Label{};
  return cell;
}

std::optional<std::string> labelText(const TableCell& cell) {
  return cell.textLabel ? cell.textLabel->text : std::nullopt;
}

}  // namespace vespscope::application
