#include "frontends/quick/TableLines.h"

#include <QHash>
#include <QStringList>
#include <algorithm>
#include <iterator>

namespace vespscope::quick {

// Beside LineKey, where argument-dependent look-up finds it.
static std::size_t qHash(const LineKey& key, std::size_t seed) {
  return qHashMulti(seed, key.section, key.header, key.label, key.occurrence);
}

Lines linesOf(const application::TableSnapshot& table) {
  Lines lines;
  for (std::size_t section = 0; section < table.sections.size(); ++section) {
    const application::SectionSnapshot& snapshot = table.sections[section];
    if (snapshot.title) {
      Line& header = lines.emplace_back();
      header.key = {section, true, QString::fromStdString(*snapshot.title), 0};
      header.path = {section, 0};
    }
    QHash<QString, int> occurrences;
    for (std::size_t row = 0; row < snapshot.rows.size(); ++row) {
      const application::RowSnapshot& cell = snapshot.rows[row];
      Line& line = lines.emplace_back();
      QString label = QString::fromStdString(cell.label);
      const int occurrence = occurrences[label]++;
      line.key = {section, false, std::move(label), occurrence};
      line.path = {section, row};
      if (cell.value) line.value = QString::fromStdString(*cell.value);
      line.disclosure = cell.disclosure;
    }
  }
  return lines;
}

void carryOver(const Lines& before, Lines& now) {
  QHash<LineKey, const Line*> known;
  known.reserve(static_cast<qsizetype>(before.size()));
  for (const Line& line : before) known.insert(line.key, &line);
  for (Line& line : now) {
    const Line* old = known.value(line.key, nullptr);
    line.changed = !line.key.header && (old == nullptr || old->value != line.value);
    if (old == nullptr) continue;
    line.expanded = old->expanded;
    line.opened = old->opened;
  }
}

Lines linesMatching(const Lines& lines, const QString& filter) {
  const auto matches = [&](const QString& text) { return text.contains(filter, Qt::CaseInsensitive); };
  Lines matching;
  for (auto start = lines.begin(); start != lines.end();) {
    const auto end =
        std::find_if(start, lines.end(), [&](const Line& line) { return line.key.section != start->key.section; });
    const bool titled = start->key.header;
    const bool whole = filter.isEmpty() || (titled && matches(start->key.label));
    Lines rows;
    std::copy_if(titled ? start + 1 : start, end, std::back_inserter(rows), [&](const Line& row) {
      return whole || matches(row.key.label) || matches(row.value.value_or(QString()));
    });
    // A section without rows still shows that it is there.
    if (titled && (whole || !rows.empty())) matching.push_back(*start);
    if (!rows.empty()) {
      rows.front().first = true;
      rows.front().apart = !titled && !matching.empty();
      rows.back().last = true;
    }
    std::move(rows.begin(), rows.end(), std::back_inserter(matching));
    start = end;
  }
  return matching;
}

QString textOf(const Line& line) {
  return line.value ? line.key.label + QStringLiteral(": ") + *line.value : line.key.label;
}

QString textOf(const Lines& lines) {
  QStringList text;
  for (const Line& line : lines) {
    if (line.key.header && !text.isEmpty()) text << QString();
    text << textOf(line);
  }
  return text.join(QLatin1Char('\n'));
}

}  // namespace vespscope::quick
