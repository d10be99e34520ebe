// One table screen as its user left it: the rows read last, the filter, the selected row and the place.
#pragma once

#include <cstddef>
#include <optional>

#include "platform/application/LiveTable.h"

namespace vespscope::terminal {

// A row's number is its position among the rows that pass the filter.
class ScreenModel : public application::LiveTable {
 public:
  // A row that is found again when rows and sections come and go.
  struct Place {
    application::RowIdentity identity;
    std::size_t row = 0;  // where it was last, for when it is gone
  };
  [[nodiscard]] Place placeOf(std::size_t number) const;
  // The number of the listed row that is the one wanted, or that now stands nearest to its place; empty only when no
  // row is listed.
  [[nodiscard]] std::optional<std::size_t> numberOf(const Place& place) const;

  // The number of the selected row; empty only when no row is listed. A selected row that went away is replaced by
  // the one that now stands nearest to its place, and is selected again when it comes back.
  [[nodiscard]] std::optional<std::size_t> selected() const { return numberOf(selection_); }
  void select(std::size_t number) { selection_ = placeOf(number); }

  // The first line shown, counted from the first line of a row, so that it stays when lines above come and go.
  struct Anchor {
    Place row;
    int offset = 0;
  };
  [[nodiscard]] const std::optional<Anchor>& anchor() const { return anchor_; }
  void setAnchor(std::optional<Anchor> anchor) { anchor_ = std::move(anchor); }

 private:
  Place selection_;
  std::optional<Anchor> anchor_;
};

}  // namespace vespscope::terminal
