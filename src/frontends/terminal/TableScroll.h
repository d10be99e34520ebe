// Scrolling in a table: which lines a view of some height shows, and how keys and the wheel move it.
#pragma once

#include "frontends/terminal/ScreenModel.h"
#include "frontends/terminal/TableLines.h"

namespace vespscope::terminal {

// Uses the model's selection and anchor, for lines laid out from that same model. All heights are at least 1.
class TableScroll {
 public:
  TableScroll(ScreenModel& model, const TableLines& lines, int height)
      : model_(model), lines_(lines), height_(height) {}

  // The first visible line; the view does not extend below the table's end unless the table is short.
  [[nodiscard]] int top() const;

  // Scrolls to the selected row if none of its lines is visible.
  void settle();

  // Selects the next row; a row taller than the view is scrolled through first.
  void down();
  void up();
  void pageDown();
  void pageUp();
  void home();
  void end();
  // Moves the view; the selection follows if its row would leave it.
  void scrollBy(int count);

 private:
  [[nodiscard]] int lastTop() const;
  void setTop(int line);
  void selectWithin();

  ScreenModel& model_;
  const TableLines& lines_;
  int height_;
};

}  // namespace vespscope::terminal
