#include "frontends/terminal/ScreenModel.h"

#include <algorithm>
#include <utility>

namespace vespscope::terminal {

using application::IndexPath;

ScreenModel::Place ScreenModel::placeOf(std::size_t number) const {
  const IndexPath path = rows().at(number);
  return {identityOf(path), path.row};
}

std::optional<std::size_t> ScreenModel::numberOf(const Place& place) const {
  if (rows().empty()) return std::nullopt;
  // The section itself, or the last one if the table has fewer now.
  application::RowIdentity identity = place.identity;
  identity.section = std::min(identity.section, table().sections.size() - 1);
  const IndexPath wanted = find(identity).value_or(IndexPath{identity.section, place.row});
  const auto found = std::lower_bound(rows().begin(), rows().end(), wanted, [](IndexPath one, IndexPath other) {
    return std::pair(one.section, one.row) < std::pair(other.section, other.row);
  });
  if (found == rows().end()) return rows().size() - 1;
  return static_cast<std::size_t>(found - rows().begin());
}

}  // namespace vespscope::terminal
