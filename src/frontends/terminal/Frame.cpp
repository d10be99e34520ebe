#include "frontends/terminal/Frame.h"

#include <algorithm>

#include "frontends/terminal/EmptyState.h"
#include "frontends/terminal/HelpText.h"
#include "frontends/terminal/StatusLine.h"
#include "platform/application/ClockText.h"
#include "platform/application/StatusText.h"

namespace vespscope::terminal {
namespace {

constexpr int heightForHints = 16;
constexpr int widthForAge = 60;  // below this width, the age of the values is shortened

const char* ruleGlyph(bool utf8) { return utf8 ? "─" : "-"; }
const char* leadsOn(bool utf8) { return utf8 ? "›" : ">"; }
const char* selectionMark(bool utf8) { return utf8 ? "▸" : ">"; }

class FrameWriter {
 public:
  FrameWriter(const View& view, Size size, bool utf8)
      : view_(view), shape_(shapeOf(size)), frame_{Grid(size, utf8), {}, {}, {}}, grid_(frame_.grid), utf8_(utf8) {
    frame_.rowAt.resize(static_cast<std::size_t>(size.height));
  }

  Frame write() {
    breadcrumb();
    switch (view_.pane) {
      case Pane::table:
        view_.lines->rows.empty() ? emptyState() : table();
        break;
      case Pane::log:
        log();
        break;
      case Pane::help:
        help();
        break;
    }
    rule();
    if (shape_.rule) grid_.fill(0, *shape_.rule, width(), ruleGlyph(utf8_), {Role::faint});
    if (view_.status) drawStatus(grid_, shape_.status, *view_.status, view_.now);
    if (view_.prompting) {
      prompt(shape_.hints.value_or(shape_.status));
    } else if (!view_.notice.empty()) {
      notice(shape_.hints.value_or(shape_.status));
    } else if (shape_.hints) {
      hints(*shape_.hints);
    }
    return std::move(frame_);
  }

 private:
  [[nodiscard]] int width() const { return grid_.size().width; }

  // The age of the values shown, at the end of the first line; returns the column before it.
  int age() {
    if (!view_.age || view_.pane != Pane::table) return width();
    const application::Freshness freshness = application::freshnessOf(*view_.age);
    if (freshness == application::Freshness::none) return width();
    const bool lastKnown = freshness == application::Freshness::lastKnown;
    std::string text = application::screenAgeText(*view_.age);
    if (width() < widthForAge) text = lastKnown ? "last known" : application::agoText(*view_.age->age);
    const Role role = freshness == application::Freshness::current ? Role::faint : Role::old;
    return grid_.putEndingAt(width(), 0, text, {role}) - 2;
  }

  // The path to the screen; if it is too long, its beginning is left out.
  void breadcrumb() {
    const int room = age();
    std::vector<std::string> names = view_.path;
    if (view_.pane == Pane::log) names.emplace_back("Log");
    if (view_.pane == Pane::help) names.emplace_back("Help");
    const std::string separator = utf8_ ? " › " : " > ";
    const std::string ellipsis = utf8_ ? "…" : "..";
    const auto widthFrom = [&](std::size_t first) {
      int sum = first == 0 ? 0 : widthOf(ellipsis + separator, utf8_);
      for (std::size_t depth = first; depth < names.size(); ++depth) sum += widthOf(names[depth], utf8_);
      return sum + 3 * static_cast<int>(names.size() - first - 1);
    };
    std::size_t first = 0;
    while (first + 1 < names.size() && widthFrom(first) > room) ++first;
    int column = 0;
    if (first != 0) {
      column = grid_.put(0, 0, ellipsis, {Role::faint});
      frame_.crumbs.push_back({0, column, first - 1});
      column = grid_.put(column, 0, separator, {Role::faint});
    }
    for (std::size_t depth = first; depth < names.size(); ++depth) {
      const bool last = depth + 1 == names.size();
      const int begin = column;
      const GlyphLine name = elided(glyphsOf(names[depth], utf8_), room - column, utf8_);
      column = grid_.put(column, 0, name, {last ? Role::title : Role::faint});
      if (depth < view_.path.size()) frame_.crumbs.push_back({begin, column, depth});
      if (!last) column = grid_.put(column, 0, separator, {Role::faint});
    }
  }

  // The rule below the breadcrumb shows which part of the table is visible.
  void rule() {
    grid_.fill(0, 1, width(), ruleGlyph(utf8_), {Role::faint});
    std::string left;
    std::string right = shape_.hints || view_.pane == Pane::help ? "" : " ? help ";
    if (view_.pane == Pane::table) {
      left = view_.screen->filter().empty()
                 ? sectionAbove()
                 : filterText(view_.screen->filter(), view_.screen->rows().size(), view_.screen->rowCount(), "rows");
      const auto selected = view_.screen->selected();
      if (selected && view_.lines->count() > shape_.bodyHeight) {
        right = " " + std::to_string(*selected + 1) + "/" + std::to_string(view_.screen->rows().size()) + " " + right;
      }
    } else if (view_.pane == Pane::log) {
      if (!view_.log->filter().empty()) {
        left = filterText(view_.log->filter(), view_.log->listedCount(), view_.log->lineCount(), "lines");
      }
      right = view_.log->follows() ? " newest " : " " + std::to_string(view_.log->linesBelow()) + " below ";
    }
    const int end = width() - 1;
    const int start = right.empty() ? end : grid_.putEndingAt(end, 1, right, {Role::faint});
    if (!left.empty()) {
      const int column = grid_.put(1, 1, " ");
      grid_.put(grid_.put(column, 1, elided(glyphsOf(left, utf8_), start - column - 2, utf8_), {Role::header}), 1, " ");
    }
  }

  static std::string filterText(const std::string& filter, std::size_t shown, std::size_t all, const char* what) {
    return std::to_string(shown) + " of " + std::to_string(all) + " " + what + " with \"" + filter + "\"";
  }

  // The section of the first visible row if its header is scrolled out of view.
  [[nodiscard]] std::string sectionAbove() const {
    if (view_.top >= view_.lines->count()) return {};
    const TableLine& line = view_.lines->lines[static_cast<std::size_t>(view_.top)];
    if (line.kind != TableLine::Kind::row) return {};
    return view_.screen->table().sections.at(line.section).title.value_or("");
  }

  void table() {
    const auto selected = view_.screen->selected();
    for (int step = 0; step < shape_.bodyHeight && view_.top + step < view_.lines->count(); ++step) {
      const TableLine& line = view_.lines->lines[static_cast<std::size_t>(view_.top) + static_cast<std::size_t>(step)];
      const int y = shape_.body + step;
      if (line.kind == TableLine::Kind::header) grid_.put(1, y, line.label, {Role::header});
      if (line.kind != TableLine::Kind::row) continue;
      frame_.rowAt[static_cast<std::size_t>(y)] = line.row;
      row(line, y);
      if (selected == line.row) {
        if (line.first) grid_.put(0, y, selectionMark(utf8_));
        grid_.select(y);
      }
    }
  }

  void row(const TableLine& line, int y) {
    const application::IndexPath path = view_.screen->rows()[line.row];
    const application::RowSnapshot& content = view_.screen->row(path);
    const Style style{view_.screen->hasChanged(path) ? Role::changed : Role::text};
    if (line.first && style.role == Role::changed) grid_.put(1, y, "*", style);
    grid_.put(TableLines::labelColumn, y, line.label, content.value ? Style{} : style);
    grid_.put(view_.lines->valueColumn + (line.first ? 0 : view_.lines->hang), y, line.value, style);
    if (line.first && content.disclosure) {
      const int column = content.value ? width() - 1 : view_.lines->valueColumn;
      grid_.put(column, y, leadsOn(utf8_), {Role::faint});
    }
  }

  void paragraph(int& y, const std::string& text, Style style) {
    const int room = std::min(width() - 2 * TableLines::labelColumn, 72);
    for (const GlyphLine& line : wrapped(glyphsOf(text, utf8_), room, room)) {
      if (y < shape_.body + shape_.bodyHeight) grid_.put(TableLines::labelColumn, y++, line, style);
    }
  }

  void emptyState() {
    const EmptyState state = emptyStateOf(*view_.screen, view_.status ? &*view_.status : nullptr, utf8_);
    int y = shape_.body + (shape_.hints ? 1 : 0);
    paragraph(y, state.title, {Role::header});
    ++y;
    paragraph(y, state.explanation, {});
  }

  void log() {
    view_.log->draw(grid_, shape_.body, shape_.bodyHeight);
    if (view_.log->listedCount() != 0) return;
    int y = shape_.body + (shape_.hints ? 1 : 0);
    paragraph(y, view_.log->lineCount() == 0 ? "Nothing has been logged yet." : "No line contains the filter's text.",
              {Role::header});
  }

  void help() {
    const std::vector<HelpLine> lines = helpLines(width(), utf8_);
    for (int step = 0; step < shape_.bodyHeight; ++step) {
      const auto index = static_cast<std::size_t>(view_.top) + static_cast<std::size_t>(step);
      if (index >= lines.size()) break;
      grid_.put(lines[index].header ? 1 : 3, shape_.body + step, lines[index].key,
                {lines[index].header ? Role::header : Role::text});
      grid_.put(helpTextColumn, shape_.body + step, lines[index].text);
    }
  }

  // The filter while it is typed; its end is visible.
  void prompt(int y) {
    const bool log = view_.pane == Pane::log;
    const std::string& filter = log ? view_.log->filter() : view_.screen->filter();
    const std::size_t shown = log ? view_.log->listedCount() : view_.screen->rows().size();
    const std::size_t all = log ? view_.log->lineCount() : view_.screen->rowCount();
    const std::string count = " " + std::to_string(shown) + " of " + std::to_string(all);
    grid_.fill(0, y, width(), " ");
    const int end = width() - widthOf(count, utf8_);
    GlyphLine typed = glyphsOf("/" + filter, utf8_);
    auto first = typed.begin();
    for (int excess = widthOf(typed) - (end - 1); excess > 0; ++first) excess -= first->width;
    typed.erase(typed.begin(), first);
    frame_.cursor = std::pair(grid_.put(0, y, typed), y);
    grid_.putEndingAt(width(), y, count, {Role::faint});
  }

  void notice(int y) {
    grid_.fill(0, y, width(), " ");
    grid_.put(0, y, elided(glyphsOf(view_.notice, utf8_), width(), utf8_), {Role::header});
  }

  void hints(int y) {
    std::string text;
    if (view_.pane == Pane::help) {
      text = "esc close   up down scroll   q quit";
    } else if (view_.pane == Pane::log) {
      text = std::string(view_.log->filter().empty() ? "esc close" : "esc clear filter") +
             "   / filter   g oldest   G newest   q quit";
    } else {
      const auto selected = view_.screen->selected();
      const bool leads = selected && view_.screen->row(view_.screen->rows()[*selected]).disclosure;
      if (leads) text += "enter open   ";
      if (!view_.screen->filter().empty()) {
        text += "esc clear filter   ";
      } else if (view_.path.size() > 1) {
        text += "esc back   ";
      }
      if (const auto next = view_.status ? application::nextSim(view_.status->sims) : std::nullopt) {
        text += "s SIM " + std::to_string(*next) + "   ";
      }
      text += "/ filter   y copy   l log   ? help   q quit";
    }
    grid_.put(0, y, elided(glyphsOf(text, utf8_), width(), utf8_), {Role::faint});
  }

  const View& view_;
  FrameShape shape_;
  Frame frame_;
  Grid& grid_;
  bool utf8_;
};

Frame tooSmall(Size size, bool utf8) {
  Frame frame{Grid(size, utf8), {}, {}, {}};
  const auto text = [](Size of) { return std::to_string(of.width) + "x" + std::to_string(of.height); };
  const std::string message = "terminal too small (" + text(size) + ", needs " + text(smallestSize) + ")";
  int y = 0;
  for (const GlyphLine& line : wrapped(glyphsOf(message, utf8), std::max(size.width, 2), std::max(size.width, 2))) {
    frame.grid.put(0, y++, line);
  }
  frame.rowAt.resize(static_cast<std::size_t>(std::max(size.height, 0)));
  return frame;
}

}  // namespace

FrameShape shapeOf(Size size) {
  FrameShape shape;
  shape.status = size.height - 1;
  if (size.height >= heightForHints) {
    shape.hints = size.height - 1;
    shape.status = size.height - 2;
    shape.rule = size.height - 3;
  }
  shape.bodyHeight = shape.rule.value_or(shape.status) - shape.body;
  return shape;
}

Frame layOutFrame(const View& view, Size size, bool utf8) {
  if (isTooSmall(size)) return tooSmall(size, utf8);
  return FrameWriter(view, size, utf8).write();
}

}  // namespace vespscope::terminal
