// Moving about in a table: which lines a view of some height shows, and where keys and the wheel lead.
#pragma once

#include "frontends/terminal/ScreenModel.h"
#include "frontends/terminal/TableLines.h"

namespace vespscope::terminal {

// Acts on the model's selection and anchor, for lines laid out from that same model. All heights are at least 1.
class TableScroll {
 public:
  TableScroll(ScreenModel& model, const TableLines& lines, int height)
      : model_(model), lines_(lines), height_(height) {}

  // The first line shown; the view never ends before the table does unless the table is short.
  [[nodiscard]] int top() const;

  // Brings the selected row back into view when no line of it is left there.
  void settle();

  // One row on; a row taller than the view is first scrolled through.
  void down();
  void up();
  void pageDown();
  void pageUp();
  void home();
  void end();
  // Moves the view; the selection follows when its row would leave it.
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
