// A table row's cell: what the interface description's prototype gives it and what a screen fills in.
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
  bool disclosure = false;  // shows a mark that selecting the row leads on
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

// The text of a cell's main label; empty when it has no such label or no text in it.
[[nodiscard]] std::optional<std::string> labelText(const TableCell& cell);

// A cell as a prototype makes it: labels of its style, without text.
[[nodiscard]] std::shared_ptr<TableCell> makeCell(const CellPrototype& prototype);

}  // namespace vespscope::application
