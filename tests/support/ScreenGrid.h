// A table screen as a grid of text, for comparing whole screens.
#pragma once

#include <string>

#include "platform/application/TableViewController.h"

namespace vespscope::test {

// One line per row: the label, padded to the longest one of the screen, and the value; a line "-- title --" before each
// section with a title, "--" between sections that have none. A screen without sections is "(no sections)", a section
// without rows "(no rows)".
[[nodiscard]] std::string gridOf(application::TableViewController& screen);

}  // namespace vespscope::test
