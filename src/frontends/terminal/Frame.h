// The layout of the whole terminal, and what its places mean to the mouse.
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

// The use of the terminal's lines; only for sizes that are not too small. Line 0 is the breadcrumb and line 1 a rule.
struct FrameShape {
  int body = 2;
  int bodyHeight = 0;
  std::optional<int> rule;  // below the body
  int status = 0;
  std::optional<int> hints;
};
[[nodiscard]] FrameShape shapeOf(Size size);

enum class Pane { table, log, help };

// The contents of a frame.
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
  std::string notice;                         // shown instead of the hints, about the user's last action
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
  std::vector<std::optional<std::size_t>> rowAt;  // by line of the terminal: the number of the row in it
  std::optional<std::pair<int, int>> cursor;      // column and line, while text is being typed
};

[[nodiscard]] Frame layOutFrame(const View& view, Size size, bool utf8);

}  // namespace vespscope::terminal
