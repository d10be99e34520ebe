// The whole terminal as it is to look, and what its places mean to the mouse.
#pragma once

#include <chrono>
#include <cstddef>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "frontends/terminal/Grid.h"
#include "frontends/terminal/LogPane.h"
#include "frontends/terminal/ScreenModel.h"
#include "frontends/terminal/TableLines.h"
#include "platform/application/ScreenAge.h"
#include "platform/application/Status.h"

namespace vespscope::terminal {

inline constexpr Size smallestSize{40, 12};

[[nodiscard]] inline bool isTooSmall(Size size) {
  return size.width < smallestSize.width || size.height < smallestSize.height;
}

// Which lines of the terminal hold what; only for sizes that are not too small. Line 0 is the breadcrumb and line 1
// a rule.
struct FrameShape {
  int body = 2;
  int bodyHeight = 0;
  std::optional<int> rule;  // below the body
  int status = 0;
  std::optional<int> hints;
};
[[nodiscard]] FrameShape shapeOf(Size size);

enum class Pane { table, log, help };

// All that a frame shows.
struct View {
  std::vector<std::string> path;  // titles of the screens from the first one on
  Pane pane = Pane::table;
  bool prompting = false;  // the filter is being typed
  const ScreenModel* screen = nullptr;
  const TableLines* lines = nullptr;
  int top = 0;  // first line shown, of the table or of the help
  LogPane* log = nullptr;
  std::optional<application::Status> status;
  std::optional<application::ScreenAge> age;  // of the values that the screen shows
  std::string notice;                         // in place of the hints, about what the user just did
  std::chrono::system_clock::time_point now;
};

struct Frame {
  Grid grid;
  struct Crumb {
    int begin = 0;  // columns
    int end = 0;
    std::size_t depth = 0;  // in the path
  };
  std::vector<Crumb> crumbs;
  std::vector<std::optional<std::size_t>> rowAt;  // by line of the terminal: the number of the row shown there
  std::optional<std::pair<int, int>> cursor;      // column and line, while text is being typed
};

[[nodiscard]] Frame layOutFrame(const View& view, Size size, bool utf8);

}  // namespace vespscope::terminal
