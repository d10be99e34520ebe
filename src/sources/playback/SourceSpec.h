// The words that name a source: "scenario:seed=3,speed=10", "replay:drive.pcap,loop", "diag:modem.mi2log",
// "diag:/dev/ttyUSB0", "diag:tcp:127.0.0.1:5000".
//
// Options follow after commas; a comma that belongs to a file's name is written twice.
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
  std::uint64_t seed = 1;  // of a scenario
  std::string file;        // of a replay or a modem log, or the port of a live one
  PlaybackOptions playback;
  std::optional<std::int32_t> sim;  // of a modem log: which SIM card, by the number that the modem gives it

  // What `words` mean, or why they mean nothing.
  static Result<SourceSpec> parse(std::string_view words);

  // Whether it is a modem's, which can neither be played in another way nor read ahead of its time.
  [[nodiscard]] bool isLive() const { return kind == Kind::diagPort || kind == Kind::modemManager; }
};

}  // namespace vespscope::sources
