// The words that name a source: "scenario:seed=3,speed=10", "replay:drive.pcap,loop", "diag:modem.mi2log",
// "diag:/dev/ttyUSB0", "diag:tcp:127.0.0.1:5000".
//
// Options follow after commas; a comma in a file's name is written twice.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "sources/playback/Playback.h"
#include "values/Result.h"

namespace vespscope::sources {

struct SourceSpec {
  enum class Kind { scenario, replay, diag, diagPort, modemManager };

  Kind kind = Kind::scenario;
  std::uint64_t seed = 1;  // for a scenario
  std::string file;        // for a replay or a modem log, or the port of a live log
  PlaybackOptions playback;
  std::optional<std::int32_t> sim;  // for a recording or a log port: the SIM card, by its number in the log

  // Returns the meaning of `words`, or why they are invalid.
  static Result<SourceSpec> parse(std::string_view words);

  // Whether the source is a modem, whose events have no other timing and cannot be read ahead.
  [[nodiscard]] bool isLive() const { return kind == Kind::diagPort || kind == Kind::modemManager; }
};

}  // namespace vespscope::sources
