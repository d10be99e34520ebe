// The command line of the viewer.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "rhoxlink/Address.h"
#include "tools/CommandLine.h"

namespace vespscope {

enum class UserInterface { quick, terminal, none };

struct ViewerOptions {
  rhox::client::Address manager;
  std::optional<UserInterface> interface;  // empty: chosen by the environment
  std::optional<std::int32_t> sim;         // the SIM card to show first; empty: the source's choice
};

using ViewerCommandLine = CommandLine<ViewerOptions>;

// Reads the command line; the default address is the environment's RHOX_ADDRESS.
[[nodiscard]] ViewerCommandLine readViewerCommandLine(int argc, const char* const* argv);

}  // namespace vespscope
