// The words that name a source: "scenario:seed=3,speed=10", "replay:drive.pcap,loop", "diag:modem.mi2log".
//
// Options follow after commas; a comma that belongs to a file's name is written twice.
#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "manager/Playback.h"
#include "values/Result.h"

namespace vespscope::manager {

struct SourceSpec {
  enum class Kind { scenario, replay, diag, modemManager };

  Kind kind = Kind::scenario;
  std::uint64_t seed = 1;  // of a scenario
  std::string file;        // of a replay or a modem log
  PlaybackOptions playback;

  // What `words` mean, or why they mean nothing.
  static Result<SourceSpec> parse(std::string_view words);
};

}  // namespace vespscope::manager
