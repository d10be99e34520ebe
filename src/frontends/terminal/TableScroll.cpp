#include "frontends/terminal/TableScroll.h"

#include <algorithm>

namespace vespscope::terminal {

int TableScroll::lastTop() const { return std::max(lines_.count() - height_, 0); }

int TableScroll::top() const {
  if (!model_.anchor()) return 0;
  const auto row = model_.numberOf(model_.anchor()->row);
  if (!row) return 0;
  return std::clamp(lines_.rows.at(*row).begin + model_.anchor()->offset, 0, lastTop());
}

void TableScroll::setTop(int line) {
  line = std::clamp(line, 0, lastTop());
  if (line == 0 || lines_.rows.empty()) {
    model_.setAnchor(std::nullopt);
    return;
  }
  // The row that the line belongs to or precedes.
  auto row =
      std::find_if(lines_.rows.begin(), lines_.rows.end(), [line](const auto& extent) { return extent.end > line; });
  if (row == lines_.rows.end()) --row;
  const auto number = static_cast<std::size_t>(row - lines_.rows.begin());
  model_.setAnchor(ScreenModel::Anchor{model_.placeOf(number), line - row->begin});
}

void TableScroll::settle() {
  const auto selected = model_.selected();
  if (!selected) return;
  const TableLines::Extent& row = lines_.rows.at(*selected);
  const int first = top();
  if (row.end <= first) {
    setTop(row.end - row.block <= height_ ? row.block : row.begin);
  } else if (row.begin >= first + height_) {
    setTop(std::min(row.end - height_, row.begin));
  }
}

void TableScroll::down() {
  const auto selected = model_.selected();
  if (!selected) return;
  const TableLines::Extent& row = lines_.rows.at(*selected);
  if (row.end > top() + height_) {
    setTop(top() + 1);
  } else if (*selected + 1 < lines_.rows.size()) {
    model_.select(*selected + 1);
    const TableLines::Extent& next = lines_.rows.at(*selected + 1);
    if (next.end > top() + height_) setTop(std::min(next.end - height_, next.begin));
  } else {
    setTop(lastTop());
  }
}

void TableScroll::up() {
  const auto selected = model_.selected();
  if (!selected) return;
  const TableLines::Extent& row = lines_.rows.at(*selected);
  if (row.begin < top()) {
    setTop(top() - 1);
  } else if (*selected > 0) {
    model_.select(*selected - 1);
    const TableLines::Extent& next = lines_.rows.at(*selected - 1);
    const int wanted = next.end - next.block <= height_ ? next.block : std::max(next.begin, next.end - height_);
    if (wanted < top()) setTop(wanted);
  } else {
    setTop(0);
  }
}

void TableScroll::selectWithin() {
  const auto selected = model_.selected();
  if (!selected) return;
  const int first = top();
  const auto visible = [&](const TableLines::Extent& row) { return row.end > first && row.begin < first + height_; };
  if (visible(lines_.rows.at(*selected))) return;
  if (lines_.rows.at(*selected).begin < first) {
    const auto row = std::find_if(lines_.rows.begin(), lines_.rows.end(), visible);
    if (row != lines_.rows.end()) model_.select(static_cast<std::size_t>(row - lines_.rows.begin()));
  } else {
    const auto row = std::find_if(lines_.rows.rbegin(), lines_.rows.rend(), visible);
    if (row != lines_.rows.rend()) model_.select(static_cast<std::size_t>(lines_.rows.rend() - row) - 1);
  }
}

void TableScroll::scrollBy(int count) {
  setTop(top() + count);
  selectWithin();
}

void TableScroll::pageDown() {
  if (top() == lastTop()) {
    end();
    return;
  }
  setTop(top() + std::max(height_ - 1, 1));
  selectWithin();
}

void TableScroll::pageUp() {
  if (top() == 0) {
    home();
    return;
  }
  setTop(top() - std::max(height_ - 1, 1));
  selectWithin();
}

void TableScroll::home() {
  if (!lines_.rows.empty()) model_.select(0);
  setTop(0);
}

void TableScroll::end() {
  if (!lines_.rows.empty()) model_.select(lines_.rows.size() - 1);
  setTop(lastTop());
}

}  // namespace vespscope::terminal
