// Where the playback of a recording stands.
#pragma once

#include <chrono>
#include <optional>

namespace vespscope {

struct PlaybackPosition {
  std::chrono::nanoseconds position{0};            // in the recording's own time from its first event, holes included
  std::optional<std::chrono::nanoseconds> length;  // of the whole recording; unavailable for a pipe
  std::chrono::nanoseconds clock{0};               // the recording's own clock there, since 1970-01-01 UTC
  double speed = 1;                                // recorded seconds for each second; infinity: as fast as possible
  bool ended = false;                              // the last event has been played
};

}  // namespace vespscope
