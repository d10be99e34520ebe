// The command line of the viewer.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "rhoxlink/Address.h"

namespace vespscope {

inline constexpr int usageStatus = 2;  // the exit status after invalid arguments

enum class UserInterface { quick, terminal, none };

struct ViewerOptions {
  rhox::client::Address manager;
  std::optional<UserInterface> interface;  // empty: chosen by the environment
  std::optional<std::int32_t> sim;         // the SIM card to show first; empty: the source's choice
};

// The result of reading a command line: options to run with, or a text to print and an exit status.
struct ViewerCommandLine {
  std::optional<ViewerOptions> options;
  std::string text;
  int status = 0;  // 0: the text goes to standard output; else it is one line for standard error
};

// Reads the command line; the default address is the environment's RHOX_ADDRESS.
[[nodiscard]] ViewerCommandLine readViewerCommandLine(int argc, const char* const* argv);

}  // namespace vespscope
