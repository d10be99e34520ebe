// The terminal interface: draws the navigation stack's table screens with curses while the main loop runs.
#pragma once

#include <memory>
#include <optional>
#include <string>

#include "platform/application/Application.h"

namespace vespscope::terminal {

// Whether there is a terminal to draw on: standard input and output, or the controlling terminal in their place, so
// that either may be redirected.
[[nodiscard]] bool isTerminalAvailable();

struct TerminalOptions {
  std::optional<bool> utf8;     // empty: as the locale says
  std::optional<bool> colours;  // empty: unless the environment's NO_COLOR is set
};

// The program has set its character locale before. From here on the terminal belongs to the frontend, so lines of the
// log are kept for its log pane. Its `run` ends with 0 when the user quits or on SIGINT, SIGTERM and SIGHUP; without a
// usable terminal it ends with 1 and one line on standard error.
[[nodiscard]] std::unique_ptr<application::Frontend> makeTerminalFrontend(TerminalOptions options = {});

}  // namespace vespscope::terminal
