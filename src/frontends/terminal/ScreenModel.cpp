#include "frontends/terminal/ScreenModel.h"

#include <algorithm>
#include <utility>

#include "frontends/terminal/CellText.h"

namespace vespscope::terminal {
namespace {

using application::IndexPath;
using application::RowSnapshot;
using application::SectionSnapshot;

std::size_t occurrenceOf(const SectionSnapshot& section, std::size_t row) {
  std::size_t before = 0;
  for (std::size_t index = 0; index < row; ++index) before += section.rows[index].label == section.rows[row].label;
  return before;
}

std::optional<std::size_t> findRow(const SectionSnapshot& section, const std::string& label, std::size_t occurrence) {
  for (std::size_t row = 0; row < section.rows.size(); ++row) {
    if (section.rows[row].label == label && occurrence-- == 0) return row;
  }
  return std::nullopt;
}

}  // namespace

void ScreenModel::reload(application::TableSnapshot table) {
  std::vector<std::vector<bool>> changed;
  for (std::size_t section = 0; section < table.sections.size(); ++section) {
    const SectionSnapshot& now = table.sections[section];
    std::vector<bool>& marks = changed.emplace_back(now.rows.size(), read_);
    if (!read_ || section >= table_.sections.size()) continue;
    const SectionSnapshot& before = table_.sections[section];
    bool aligned = true;  // so far both have the same labels in the same places, as nearly always
    for (std::size_t row = 0; row < now.rows.size(); ++row) {
      aligned = aligned && row < before.rows.size() && before.rows[row].label == now.rows[row].label;
      const std::optional<std::size_t> same =
          aligned ? row : findRow(before, now.rows[row].label, occurrenceOf(now, row));
      marks[row] = !same || before.rows[*same].value != now.rows[row].value;
    }
  }
  table_ = std::move(table);
  changed_ = std::move(changed);
  read_ = true;
  listRows();
}

bool ScreenModel::hasChanged(IndexPath path) const { return changed_.at(path.section).at(path.row); }

std::size_t ScreenModel::rowCount() const {
  std::size_t count = 0;
  for (const SectionSnapshot& section : table_.sections) count += section.rows.size();
  return count;
}

void ScreenModel::setFilter(std::string filter) {
  filter_ = std::move(filter);
  listRows();
}

void ScreenModel::listRows() {
  const std::string wanted = caseFolded(filter_);
  const auto passes = [&wanted](const RowSnapshot& row) {
    return wanted.empty() || caseFolded(row.label).find(wanted) != std::string::npos ||
           (row.value && caseFolded(*row.value).find(wanted) != std::string::npos);
  };
  rows_.clear();
  for (std::size_t section = 0; section < table_.sections.size(); ++section) {
    const std::vector<RowSnapshot>& rows = table_.sections[section].rows;
    for (std::size_t row = 0; row < rows.size(); ++row) {
      if (passes(rows[row])) rows_.push_back({section, row});
    }
  }
}

const RowSnapshot& ScreenModel::row(IndexPath path) const { return table_.sections.at(path.section).rows.at(path.row); }

void ScreenModel::select(std::size_t number) { selection_ = identityOf(number); }

RowIdentity ScreenModel::identityOf(std::size_t number) const {
  const IndexPath path = rows_.at(number);
  return {path.section, row(path).label, occurrenceOf(table_.sections[path.section], path.row), path.row};
}

std::optional<std::size_t> ScreenModel::numberOf(const RowIdentity& identity) const {
  if (rows_.empty()) return std::nullopt;
  // The section itself, or the last one when there are fewer now.
  const std::size_t section = std::min(identity.section, table_.sections.size() - 1);
  const auto found = findRow(table_.sections[section], identity.label, identity.occurrence);
  const IndexPath wanted{section, found.value_or(identity.row)};
  const auto place = std::lower_bound(rows_.begin(), rows_.end(), wanted, [](IndexPath one, IndexPath other) {
    return std::pair(one.section, one.row) < std::pair(other.section, other.row);
  });
  if (place == rows_.end()) return rows_.size() - 1;
  return static_cast<std::size_t>(place - rows_.begin());
}

}  // namespace vespscope::terminal
