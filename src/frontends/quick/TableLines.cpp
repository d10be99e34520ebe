#include "frontends/quick/TableLines.h"

#include <utility>

namespace vespscope::quick {
namespace {

Line lineOf(const application::LiveTable& table, application::IndexPath path) {
  const application::RowSnapshot& row = table.row(path);
  Line line;
  line.identity = table.identityOf(path);
  line.path = path;
  line.label = QString::fromStdString(row.label);
  if (row.value) line.value = QString::fromStdString(*row.value);
  line.disclosure = row.disclosure;
  line.changed = table.hasChanged(path);
  return line;
}

}  // namespace

Lines linesOf(const application::LiveTable& table) {
  Lines lines;
  auto row = table.rows().begin();
  for (std::size_t section = 0; section < table.table().sections.size(); ++section) {
    if (!table.isListed(section)) continue;
    const std::optional<std::string>& title = table.table().sections[section].title;
    bool apart = !title && !lines.empty();
    if (title) {
      Line& header = lines.emplace_back();
      header.header = true;
      header.identity = {section, *title, 0};
      header.path = {section, 0};
      header.label = QString::fromStdString(*title);
    }
    bool first = true;
    for (; row != table.rows().end() && row->section == section; ++row) {
      lines.push_back(lineOf(table, *row));
      lines.back().first = std::exchange(first, false);
      lines.back().apart = std::exchange(apart, false);
    }
    if (!first) lines.back().last = true;
  }
  return lines;
}

}  // namespace vespscope::quick
