#include "frontends/terminal/TableLines.h"

#include <algorithm>

namespace vespscope::terminal {
namespace {

using application::RowSnapshot;
using application::SectionSnapshot;

constexpr int gap = 2;  // between the columns
constexpr int widestGlyph = 2;
constexpr int smallestColumn = 8;

struct Columns {
  int label = 0;
  int value = 0;
  int hang = 0;
};

// The widest line of labels broken to a width.
int widestLine(const ScreenModel& model, int width, bool utf8) {
  int widest = 0;
  for (const SectionSnapshot& section : model.table().sections) {
    for (const RowSnapshot& row : section.rows) {
      for (const GlyphLine& line : wrapped(glyphsOf(row.label, utf8), width, width)) {
        widest = std::max(widest, widthOf(line));
      }
    }
  }
  return widest;
}

// Labels get the width they need; when labels and values do not both fit, labels get at most a little more than half of
// the width, and no more than their broken lines need.
Columns columnsFor(const ScreenModel& model, int width, bool utf8) {
  int label = 0;
  int value = 0;
  bool marksAtEdge = false;  // rows with a value have their disclosure mark at the right edge
  for (const SectionSnapshot& section : model.table().sections) {
    for (const RowSnapshot& row : section.rows) {
      label = std::max(label, widthOf(row.label, utf8));
      if (row.value) value = std::max(value, widthOf(*row.value, utf8));
      marksAtEdge |= row.value && row.disclosure;
    }
  }
  const int taken = TableLines::labelColumn + gap + (marksAtEdge ? gap : 0);
  const int room = std::max(width - taken, 2 * smallestColumn);
  const int most = std::max(room * 11 / 20, room - value);
  Columns columns;
  columns.label = std::max(label <= most ? label : widestLine(model, most, utf8), widestGlyph);
  columns.value = room - columns.label;
  columns.hang = columns.value >= 2 * smallestColumn ? 2 : 0;
  return columns;
}

void addRow(TableLines& table, const RowSnapshot& row, std::size_t section, const Columns& columns, bool utf8) {
  const std::size_t number = table.rows.size();
  const int block = table.rows.empty() ? 0 : table.rows.back().end;
  const int begin = table.count();
  auto labels = wrapped(glyphsOf(row.label, utf8), columns.label, columns.label);
  auto values = wrapped(glyphsOf(row.value.value_or(""), utf8), columns.value, columns.value - columns.hang);
  for (std::size_t line = 0; line < std::max(labels.size(), values.size()); ++line) {
    TableLine added{TableLine::Kind::row, section, number, line == 0, {}, {}};
    if (line < labels.size()) added.label = std::move(labels[line]);
    if (line < values.size()) added.value = std::move(values[line]);
    table.lines.push_back(std::move(added));
  }
  table.rows.push_back({block, begin, table.count()});
}

}  // namespace

TableLines layOutTable(const ScreenModel& model, int width, bool utf8) {
  const Columns columns = columnsFor(model, width, utf8);
  TableLines table;
  table.lines.reserve(model.rows().size() + 2 * model.table().sections.size());
  table.rows.reserve(model.rows().size());
  table.valueColumn = TableLines::labelColumn + columns.label + gap;
  table.hang = columns.hang;
  auto row = model.rows().begin();
  for (std::size_t section = 0; section < model.table().sections.size(); ++section) {
    const SectionSnapshot& snapshot = model.table().sections[section];
    const bool listed = row != model.rows().end() && row->section == section;
    if (!model.isListed(section)) continue;
    if (!table.lines.empty() && (snapshot.title || listed)) {
      table.lines.push_back({TableLine::Kind::blank, section, 0, false, {}, {}});
    }
    if (snapshot.title) {
      GlyphLine title = elided(glyphsOf(*snapshot.title, utf8), std::max(width - 1, 1), utf8);
      table.lines.push_back({TableLine::Kind::header, section, 0, false, std::move(title), {}});
    }
    for (; row != model.rows().end() && row->section == section; ++row) {
      addRow(table, model.row(*row), section, columns, utf8);
    }
  }
  return table;
}

}  // namespace vespscope::terminal
