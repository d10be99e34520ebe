// The commands of vespctl. Each writes to standard output and returns nothing, or the one-line reason why it stopped;
// what came before the reason has been written.
#pragma once

#include <chrono>
#include <optional>
#include <string>

namespace vespscope::tools {

using Problem = std::optional<std::string>;

// One JSON object per packet of the capture: the message as decoded.
[[nodiscard]] Problem decode(const std::string& file);

// One JSON object: everything that the decoder holds after the capture's events.
[[nodiscard]] Problem state(const std::string& file);

// A JSON array of the viewer's screens after the capture's events, in catalogue order: all of them, those of one
// launch row, or one.
[[nodiscard]] Problem screens(const std::string& file, const std::optional<std::string>& launch,
                              const std::optional<std::string>& row);

struct Conversion {
  std::string source;
  std::string output;
  std::optional<std::chrono::seconds> limit;  // of what the source plays; an endless source needs one
  bool report = false;  // print on standard error how each frame and record of a modem log was handled
  bool force = false;   // replace an existing output
};

// Runs a source as fast as it goes into a capture, which takes its name when it is whole. A signal that ends it leaves
// a partial capture and ends the process.
[[nodiscard]] Problem convert(const Conversion& conversion);

struct RecordingWish {
  std::string output;
  std::optional<std::string> address;  // of the manager; the environment's or the usual one when empty
  bool force = false;                  // replace an existing output
};

// Writes what the baseband manager delivers into a capture, which takes its name at the end, until interrupted.
[[nodiscard]] Problem record(const RecordingWish& wish);

// One JSON object: the source, configurations and clients of the manager at `address` (the environment's, else the one
// on the system bus when empty).
[[nodiscard]] Problem status(const std::optional<std::string>& address);

}  // namespace vespscope::tools
