// A whole table screen as plain data, read once through its data-source operations.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "platform/application/TableViewController.h"

namespace vespscope::application {

struct RowSnapshot {
  std::string label;
  std::optional<std::string> value;  // empty when the cell has no detail label or the label has no text
  bool disclosure = false;
  friend bool operator==(const RowSnapshot&, const RowSnapshot&) = default;
};

struct SectionSnapshot {
  std::optional<std::string> title;
  std::vector<RowSnapshot> rows;
  friend bool operator==(const SectionSnapshot&, const SectionSnapshot&) = default;
};

struct TableSnapshot {
  std::vector<SectionSnapshot> sections;
  friend bool operator==(const TableSnapshot&, const TableSnapshot&) = default;
};

[[nodiscard]] TableSnapshot readTable(TableViewController& screen);

}  // namespace vespscope::application
