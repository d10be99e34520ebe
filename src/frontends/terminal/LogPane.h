// The last lines of both log channels, as the log pane shows them: filtered, wrapped and scrolled.
#pragma once

#include <cstddef>
#include <deque>
#include <string>
#include <vector>

#include "frontends/terminal/CellText.h"
#include "frontends/terminal/Grid.h"
#include "frontends/terminal/LogMailbox.h"
#include "platform/application/TextFilter.h"
#include "platform/log/LastLines.h"

namespace vespscope::terminal {

class LogPane {
 public:
  static constexpr std::size_t capacity = LogMailbox::capacity;

  // Adds lines at the end and drops the oldest beyond the bounds.
  void add(std::deque<LogLine> lines);

  // Lists only lines that contain the text, in any case; an empty text lists all.
  void setFilter(std::string filter);
  [[nodiscard]] const std::string& filter() const { return filter_.text(); }

  [[nodiscard]] std::size_t lineCount() const { return lines_.size(); }
  [[nodiscard]] std::size_t listedCount() const { return listed_.size(); }

  // Whether the view stays at the end and shows new lines automatically.
  [[nodiscard]] bool follows() const { return follows_; }
  void follow() { follows_ = true; }
  // The number of listed lines below the view drawn last.
  [[nodiscard]] std::size_t linesBelow() const { return below_; }

  // Moves the view drawn last, towards the end for positive counts of screen lines.
  void scrollBy(int count, Size view, bool utf8);
  void home();

  // Draws into the lines [top, top + height) of the grid.
  void draw(Grid& grid, int top, int height);

 private:
  struct Position {
    std::size_t listed = 0;  // index into listed_
    int line = 0;            // of that log line's screen lines
  };

  [[nodiscard]] std::vector<GlyphLine> broken(const LogLine& line, int width, bool utf8) const;
  [[nodiscard]] int heightOf(std::size_t listed, int width, bool utf8) const;
  // The first position of a view that ends with the last line.
  [[nodiscard]] Position lastTop(Size view, bool utf8) const;
  [[nodiscard]] Position top(Size view, bool utf8) const;

  log::LastLines<LogLine> lines_;
  application::TextFilter filter_;
  std::deque<std::uint64_t> listed_;  // numbers of the lines that pass the filter
  bool follows_ = true;
  std::uint64_t topNumber_ = 0;  // of the first line shown, while not following
  int topLine_ = 0;
  std::size_t below_ = 0;
};

}  // namespace vespscope::terminal
