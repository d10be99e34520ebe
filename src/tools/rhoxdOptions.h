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
  bool relay = false;                           // by the manager on the system bus, where there is one
  std::optional<std::string> socket;            // path
  std::string source = "modemmanager";          // words
  std::string group = "vespscope";              // whose members may use it on the system bus
  std::optional<std::filesystem::path> state;   // folder; empty: configurations are not kept
  std::optional<std::filesystem::path> record;  // folder; empty: nothing is recorded
  manager::RecordingLimits recordingLimits;
};

// What came of reading a command line: options to run with, or a text to print and a status to exit with.
struct DaemonCommandLine {
  std::optional<DaemonOptions> options;
  std::string text;
  int status = 0;  // 0: the text is an answer for standard output; else it is one line for standard error
};

[[nodiscard]] DaemonCommandLine readDaemonCommandLine(int argc, const char* const* argv);

}  // namespace vespscope
