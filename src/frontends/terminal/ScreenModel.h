// The state of one table screen: the rows read last, the filter, the selected row and the scroll position.
#pragma once

#include <cstddef>
#include <optional>

#include "platform/application/LiveTable.h"

namespace vespscope::terminal {

// A row's number is its position among the rows that pass the filter.
class ScreenModel : public application::LiveTable {
 public:
  // A row that can be found again after rows and sections were added or removed.
  struct Place {
    application::RowIdentity identity;
    std::size_t row = 0;  // its last position, used after it is gone
  };
  [[nodiscard]] Place placeOf(std::size_t number) const;
  // The number of the listed row that this place names, or of the one nearest to its last position; empty only when no
  // row is listed.
  [[nodiscard]] std::optional<std::size_t> numberOf(const Place& place) const;

  // The number of the selected row; empty only when no row is listed. If the selected row is gone, the row nearest to
  // its last position is selected, until it comes back.
  [[nodiscard]] std::optional<std::size_t> selected() const { return numberOf(selection_); }
  void select(std::size_t number) { selection_ = placeOf(number); }

  // The first visible line, counted from the first line of a row, so that it stays in place when lines above are added
  // or removed.
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
