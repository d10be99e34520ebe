// The help: the keys and the meaning of the marks on the screen.
#pragma once

#include <vector>

#include "frontends/terminal/CellText.h"

namespace vespscope::terminal {

struct HelpLine {
  GlyphLine key;
  GlyphLine text;
  bool header = false;  // `key` is the title of a group
};

[[nodiscard]] std::vector<HelpLine> helpLines(int width, bool utf8);

inline constexpr int helpTextColumn = 20;

}  // namespace vespscope::terminal
