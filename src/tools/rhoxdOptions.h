// The command line of the baseband manager.
#pragma once

#include <filesystem>
#include <optional>
#include <string>

#include "manager/recording/RotatingCapture.h"
#include "sources/playback/SourceSpec.h"

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

// The result of reading a command line: options to run with, or a text to print and an exit status.
struct DaemonCommandLine {
  std::optional<DaemonOptions> options;
  std::string text;
  int status = 0;  // 0: the text goes to standard output; else it is one line for standard error
};

[[nodiscard]] DaemonCommandLine readDaemonCommandLine(int argc, const char* const* argv);

}  // namespace vespscope
