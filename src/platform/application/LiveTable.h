// A table screen across its reloads: which row is which, which rows changed, and which ones pass the user's filter.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

#include "platform/application/TableSnapshot.h"
#include "platform/application/TextFilter.h"

namespace vespscope::application {

// Identifies a row to the user, whatever its value: by its label, and by its order among rows of the same label in its
// section.
struct RowIdentity {
  std::size_t section = 0;
  std::string label;
  std::size_t occurrence = 0;  // counts the section's earlier rows of the same label
  friend bool operator==(const RowIdentity&, const RowIdentity&) = default;
};

class LiveTable {
 public:
  // Takes the rows of a reload. From the second reload on, rows whose value differs from the one before, and rows that
  // were not there before, count as changed until the next reload.
  void reload(TableSnapshot table);
  // From this call until the next reload no row counts as changed.
  void forgetChanges();

  [[nodiscard]] const TableSnapshot& table() const { return table_; }
  [[nodiscard]] bool hasChanged(IndexPath path) const { return changed_.at(path.section).at(path.row); }
  [[nodiscard]] bool hasChanges() const;
  [[nodiscard]] std::size_t rowCount() const;
  [[nodiscard]] const RowSnapshot& row(IndexPath path) const;

  // Lists only rows whose label, value or section title contains the text, in any case; an empty text lists all.
  void setFilter(std::string text);
  [[nodiscard]] const std::string& filter() const { return filter_.text(); }

  // The rows that pass the filter, in order.
  [[nodiscard]] const std::vector<IndexPath>& rows() const { return rows_; }
  // Whether the section's title, if it has one, is shown above the listed rows. Without a filter a section without rows
  // shows its title as well.
  [[nodiscard]] bool isListed(std::size_t section) const { return listed_.at(section); }

  [[nodiscard]] RowIdentity identityOf(IndexPath path) const;
  // Where the row is now; empty when the table has no such row.
  [[nodiscard]] std::optional<IndexPath> find(const RowIdentity& identity) const;

 private:
  void listRows();

  TableSnapshot table_;
  std::vector<std::vector<bool>> changed_;  // by section and row
  bool read_ = false;
  TextFilter filter_;
  std::vector<IndexPath> rows_;
  std::vector<bool> listed_;  // by section
};

// The text that a user copies from a row: "label: value", or the label alone.
[[nodiscard]] std::string rowText(const RowSnapshot& row);

// The text that a user copies from a screen: its title, then the listed sections and rows, one per line, with an empty
// line before each section.
[[nodiscard]] std::string tableText(const std::string& title, const LiveTable& table);

}  // namespace vespscope::application
