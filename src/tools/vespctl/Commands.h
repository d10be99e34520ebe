// The commands of vespctl. Each writes to standard output and returns nothing, or the one-line reason why it stopped;
// output before the failure has been written.
#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>

#include "values/Result.h"

namespace vespscope::tools {

using Problem = std::optional<std::string>;

// The number of the SIM card whose events are used.
using Sim = std::optional<std::int32_t>;

// Prints one JSON object per packet of the capture: the decoded message. With `sim`, only of that card and of no card
// in particular.
[[nodiscard]] Problem decode(const std::string& file, Sim sim);

// Prints one JSON object: the decoder's whole state after the capture's events. Of several SIM cards it is the state of
// one: `sim`, else the one that a viewer shows.
[[nodiscard]] Problem state(const std::string& file, Sim sim);

// Prints a JSON array of the viewer's screens after the capture's events, in catalogue order: all of them, those of one
// launch row, or one. `sim` as with `state`.
[[nodiscard]] Problem screens(const std::string& file, const std::optional<std::string>& launch,
                              const std::optional<std::string>& row, Sim sim);

struct Conversion {
  std::string source;
  std::string output;                         // empty: no capture, only samples
  std::optional<std::string> unread;          // folder for samples of a modem log's records that are not read
  std::optional<std::chrono::seconds> limit;  // of the source's own time; required for an endless source
  Sim sim;                                    // the only card to convert; empty: all
  bool report = false;  // print on standard error how the frames and records of a modem log were handled
  bool force = false;   // replace existing outputs
};

// Runs a source as fast as possible into a capture, which gets its name when it is complete. A signal ends the process
// and leaves a partial capture.
[[nodiscard]] Problem convert(const Conversion& conversion);

struct RecordingWish {
  std::string output;
  std::optional<std::string> address;  // of the manager; empty: the environment's or the default
  Sim sim;                             // the only card to record; empty: all
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
