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

// Runs a source as fast as it goes into a capture. `limit` ends it after so much of what it plays; an endless source
// needs one. `report` tells on standard error what became of each frame and record of a modem log.
[[nodiscard]] Problem convert(const std::string& source, const std::string& output,
                              std::optional<std::chrono::seconds> limit, bool report);

// Writes what the baseband manager at `address` (the environment's or the usual one when empty) delivers into a
// capture, until interrupted.
[[nodiscard]] Problem record(const std::string& output, const std::optional<std::string>& address);

// One JSON object: the source, configurations and clients of the manager at `address` (the environment's, else the one
// on the system bus when empty).
[[nodiscard]] Problem status(const std::optional<std::string>& address);

}  // namespace vespscope::tools
