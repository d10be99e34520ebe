// A table row's cell: the labels that the interface description's prototype defines and a screen fills in.
#pragma once

#include <memory>
#include <optional>
#include <string>

namespace vespscope::application {

struct Label {
  std::optional<std::string> text;
};

enum class CellStyle {
  basic,  // one label
  value,  // a label and a value
};

// One prototype of a screen's cells, as the interface description declares it.
struct CellPrototype {
  std::string identifier;
  CellStyle style = CellStyle::basic;
  bool disclosure = false;  // shows a mark that selecting the row opens another screen
  std::string segueTo;      // the scene that selecting the row pushes; empty: none
};

struct TableCell {
  std::string reuseIdentifier;
  CellStyle style = CellStyle::basic;
  bool disclosure = false;
  std::string segueTo;
  std::optional<Label> textLabel;
  std::optional<Label> detailTextLabel;
};

// The text of a cell's main label; empty when it has no such label or the label has no text.
[[nodiscard]] std::optional<std::string> labelText(const TableCell& cell);

// Makes a cell from a prototype: labels of its style, without text.
[[nodiscard]] std::shared_ptr<TableCell> makeCell(const CellPrototype& prototype);

}  // namespace vespscope::application
