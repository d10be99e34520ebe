// The command line of the baseband manager.
#pragma once

#include <filesystem>
#include <optional>
#include <string>

#include "manager/recording/RotatingCapture.h"
#include "sources/playback/SourceSpec.h"
#include "tools/CommandLine.h"

namespace vespscope {

struct DaemonOptions {
  bool system = false;                          // serve on the system bus
  bool stdio = false;                           // serve one client on standard input and output,
  bool relay = false;                           // through the manager on the system bus if there is one
  std::optional<std::string> socket;            // path
  std::string source = "modemmanager";          // words
  std::string group = "vespscope";              // the group whose members may use it on the system bus
  std::optional<std::filesystem::path> state;   // folder; empty: configurations are not stored
  std::optional<std::filesystem::path> record;  // folder; empty: nothing is recorded
  manager::RecordingLimits recordingLimits;
};

using DaemonCommandLine = CommandLine<DaemonOptions>;

[[nodiscard]] DaemonCommandLine readDaemonCommandLine(int argc, const char* const* argv);

}  // namespace vespscope
