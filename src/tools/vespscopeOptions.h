// The command line of the viewer.
#pragma once

#include <optional>
#include <string>

#include "rhoxlink/Address.h"

namespace vespscope {

inline constexpr int usageStatus = 2;  // what the program exits with after words that it cannot follow

enum class UserInterface { quick, terminal, none };

struct ViewerOptions {
  rhox::client::Address manager;
  std::optional<UserInterface> interface;  // empty: whatever fits where the program runs
};

// What came of reading a command line: options to run with, or a text to print and a status to exit with.
struct ViewerCommandLine {
  std::optional<ViewerOptions> options;
  std::string text;
  int status = 0;  // 0: the text is an answer for standard output; else it is one line for standard error
};

// Reads the command line; an address that it does not name comes from the environment's RHOX_ADDRESS.
[[nodiscard]] ViewerCommandLine readViewerCommandLine(int argc, const char* const* argv);

}  // namespace vespscope
