// One table screen as its user left it: the rows read last, which of them changed, the filter and the place.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

#include "platform/application/TableSnapshot.h"

namespace vespscope::terminal {

// A row by what its user knows it by, so that it is found again when rows and sections come and go.
struct RowIdentity {
  std::size_t section = 0;
  std::string label;
  std::size_t occurrence = 0;  // among the section's rows of the same label
  std::size_t row = 0;         // where it was last, for when it is gone
};

class ScreenModel {
 public:
  // Takes the rows of a reload. From the second one on, rows whose value differs from the one before, or that were
  // not there before, count as changed until the next reload.
  void reload(application::TableSnapshot table);

  [[nodiscard]] const application::TableSnapshot& table() const { return table_; }
  [[nodiscard]] bool hasChanged(application::IndexPath path) const;
  [[nodiscard]] std::size_t rowCount() const;

  // Only rows whose label or value contains the text, in whatever case, are listed; an empty text lists all.
  void setFilter(std::string filter);
  [[nodiscard]] const std::string& filter() const { return filter_; }

  // The rows that pass the filter, in order; elsewhere a row's number is its position in this list.
  [[nodiscard]] const std::vector<application::IndexPath>& rows() const { return rows_; }
  [[nodiscard]] const application::RowSnapshot& row(application::IndexPath path) const;

  // The number of the selected row; empty only when no row is listed. A selected row that went away is replaced by
  // the one that now stands nearest to its place, and is selected again when it comes back.
  [[nodiscard]] std::optional<std::size_t> selected() const { return numberOf(selection_); }
  void select(std::size_t number);

  [[nodiscard]] RowIdentity identityOf(std::size_t number) const;
  // The number of the listed row that is, or stands for, the identified one; empty only when no row is listed.
  [[nodiscard]] std::optional<std::size_t> numberOf(const RowIdentity& identity) const;

  // The first line shown, counted from the first line of a row, so that it stays when lines above come and go.
  struct Anchor {
    RowIdentity row;
    int offset = 0;
  };
  [[nodiscard]] const std::optional<Anchor>& anchor() const { return anchor_; }
  void setAnchor(std::optional<Anchor> anchor) { anchor_ = std::move(anchor); }

 private:
  void listRows();

  application::TableSnapshot table_;
  std::vector<std::vector<bool>> changed_;  // by section and row
  bool read_ = false;
  std::string filter_;
  std::vector<application::IndexPath> rows_;
  RowIdentity selection_;
  std::optional<Anchor> anchor_;
};

}  // namespace vespscope::terminal
