// The commands of vespctl. Each writes to standard output and returns nothing, or the one-line reason why it stopped;
// output before the failure has been written.
#pragma once

#include <chrono>
#include <optional>
#include <string>

#include "values/Result.h"

namespace vespscope::tools {

using Problem = std::optional<std::string>;

// Prints one JSON object per packet of the capture: the decoded message.
[[nodiscard]] Problem decode(const std::string& file);

// Prints one JSON object: the decoder's whole state after the capture's events.
[[nodiscard]] Problem state(const std::string& file);

// Prints a JSON array of the viewer's screens after the capture's events, in catalogue order: all of them, those of one
// launch row, or one.
[[nodiscard]] Problem screens(const std::string& file, const std::optional<std::string>& launch,
                              const std::optional<std::string>& row);

struct Conversion {
  std::string source;
  std::string output;                         // empty: no capture, only samples
  std::optional<std::string> unread;          // folder for samples of a modem log's records that are not read
  std::optional<std::chrono::seconds> limit;  // of the source's own time; required for an endless source
  bool report = false;  // print on standard error how the frames and records of a modem log were handled
  bool force = false;   // replace existing outputs
};

// Runs a source as fast as possible into a capture, which gets its name when it is complete. A signal ends the process
// and leaves a partial capture.
[[nodiscard]] Problem convert(const Conversion& conversion);

struct RecordingWish {
  std::string output;
  std::optional<std::string> address;  // of the manager; empty: the environment's or the default
  bool force = false;                  // replace an existing output
};

// Records the baseband manager's events to a capture until interrupted; the capture gets its name at the end.
[[nodiscard]] Problem record(const RecordingWish& wish);

// Prints one JSON object: the source, configurations and clients of the manager at `address` (if empty: the
// environment's, else the one on the system bus).
[[nodiscard]] Problem status(const std::optional<std::string>& address);

struct Examination {
  std::string subject;  // a recording or a folder of captures, the words of a source, or a modem's port
  bool json = false;
};

// Prints what a recording holds for the viewer, or what a port does, and what to do next. Returns whether the viewer
// can show anything of it now.
[[nodiscard]] Result<bool> doctor(const Examination& examination);

}  // namespace vespscope::tools
