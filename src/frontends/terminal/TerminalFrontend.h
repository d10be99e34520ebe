// The terminal interface: draws the navigation stack's table screens with curses while the main loop runs.
#pragma once

#include <memory>
#include <optional>
#include <string>

#include "platform/application/Application.h"

namespace vespscope::terminal {

// Whether there is a terminal to draw on: standard input and output, or the controlling terminal, so that either may be
// redirected.
[[nodiscard]] bool isTerminalAvailable();

struct TerminalOptions {
  std::optional<bool> utf8;     // empty: decided by the locale
  std::optional<bool> colours;  // empty: true unless the environment's NO_COLOR is set
};

// Requires that the program has set its character locale. From here on the frontend controls the terminal, and log
// lines are kept for its log pane. Its `run` returns 0 when the user quits or on SIGINT, SIGTERM and SIGHUP; without a
// usable terminal it returns 1 and prints one line on standard error.
[[nodiscard]] std::unique_ptr<application::Frontend> makeTerminalFrontend(TerminalOptions options = {});

}  // namespace vespscope::terminal
