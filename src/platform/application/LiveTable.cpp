#include "platform/application/LiveTable.h"

#include <algorithm>
#include <string_view>
#include <unordered_map>
#include <utility>

#include "values/Text.h"

namespace vespscope::application {
namespace {

// The rows of a section by their label, in order.
using RowsByLabel = std::unordered_map<std::string_view, std::vector<std::size_t>>;

RowsByLabel rowsByLabel(const SectionSnapshot& section) {
  RowsByLabel rows;
  for (std::size_t row = 0; row < section.rows.size(); ++row) rows[section.rows[row].label].push_back(row);
  return rows;
}

// Returns, for each row of `now`, whether it differs from its row in `before` or is new.
std::vector<bool> changesBetween(const SectionSnapshot& before, const SectionSnapshot& now) {
  std::vector<bool> changed(now.rows.size());
  std::size_t row = 0;
  // Usually both have the same labels in the same places.
  for (; row < now.rows.size() && row < before.rows.size() && before.rows[row].label == now.rows[row].label; ++row) {
    changed[row] = before.rows[row].value != now.rows[row].value;
  }
  if (row == now.rows.size()) return changed;
  const RowsByLabel known = rowsByLabel(before);
  std::unordered_map<std::string_view, std::size_t> occurrences;
  for (std::size_t each = 0; each < row; ++each) ++occurrences[now.rows[each].label];
  for (; row < now.rows.size(); ++row) {
    const std::size_t occurrence = occurrences[now.rows[row].label]++;
    const auto same = known.find(now.rows[row].label);
    changed[row] = same == known.end() || occurrence >= same->second.size() ||
                   before.rows[same->second[occurrence]].value != now.rows[row].value;
  }
  return changed;
}

}  // namespace

void LiveTable::reload(TableSnapshot table) {
  std::vector<std::vector<bool>> changed;
  changed.reserve(table.sections.size());
  for (std::size_t section = 0; section < table.sections.size(); ++section) {
    const SectionSnapshot& now = table.sections[section];
    if (read_ && section < table_.sections.size()) {
      changed.push_back(changesBetween(table_.sections[section], now));
    } else {
      changed.emplace_back(now.rows.size(), read_);
    }
  }
  table_ = std::move(table);
  changed_ = std::move(changed);
  read_ = true;
  listRows();
}

void LiveTable::forgetChanges() {
  for (std::vector<bool>& section : changed_) section.assign(section.size(), false);
}

bool LiveTable::hasChanges() const {
  return std::any_of(changed_.begin(), changed_.end(), [](const std::vector<bool>& section) {
    return std::find(section.begin(), section.end(), true) != section.end();
  });
}

std::size_t LiveTable::rowCount() const {
  std::size_t count = 0;
  for (const SectionSnapshot& section : table_.sections) count += section.rows.size();
  return count;
}

const RowSnapshot& LiveTable::row(IndexPath path) const { return table_.sections.at(path.section).rows.at(path.row); }

void LiveTable::setFilter(std::string text) {
  if (text == filter_.text()) return;
  filter_ = TextFilter(std::move(text));
  listRows();
}

void LiveTable::listRows() {
  rows_.clear();
  listed_.assign(table_.sections.size(), false);
  for (std::size_t section = 0; section < table_.sections.size(); ++section) {
    const SectionSnapshot& snapshot = table_.sections[section];
    const bool whole = filter_.empty() || (snapshot.title && filter_.passes(*snapshot.title));
    bool any = whole;
    for (std::size_t row = 0; row < snapshot.rows.size(); ++row) {
      const RowSnapshot& content = snapshot.rows[row];
      if (!whole && !filter_.passes(content.label) && !filter_.passes(content.value.value_or(std::string()))) continue;
      rows_.push_back({section, row});
      any = true;
    }
    listed_[section] = any;
  }
}

RowIdentity LiveTable::identityOf(IndexPath path) const {
  const std::vector<RowSnapshot>& rows = table_.sections.at(path.section).rows;
  const std::string& label = rows.at(path.row).label;
  const auto before = std::count_if(rows.begin(), rows.begin() + static_cast<std::ptrdiff_t>(path.row),
                                    [&label](const RowSnapshot& row) { return row.label == label; });
  return {path.section, label, static_cast<std::size_t>(before)};
}

std::optional<IndexPath> LiveTable::find(const RowIdentity& identity) const {
  if (identity.section >= table_.sections.size()) return std::nullopt;
  const std::vector<RowSnapshot>& rows = table_.sections[identity.section].rows;
  std::size_t before = 0;
  for (std::size_t row = 0; row < rows.size(); ++row) {
    if (rows[row].label == identity.label && before++ == identity.occurrence) return IndexPath{identity.section, row};
  }
  return std::nullopt;
}

std::string rowText(const RowSnapshot& row) { return printable(row.value ? row.label + ": " + *row.value : row.label); }

std::string tableText(const std::string& title, const LiveTable& table) {
  std::string text = printable(title) + "\n";
  auto row = table.rows().begin();
  for (std::size_t section = 0; section < table.table().sections.size(); ++section) {
    if (!table.isListed(section)) continue;
    text += '\n';
    if (const auto& header = table.table().sections[section].title) text += printable(*header) + "\n";
    for (; row != table.rows().end() && row->section == section; ++row) text += rowText(table.row(*row)) + "\n";
  }
  return text;
}

}  // namespace vespscope::application
