// When each event of a stream is played: recorded time, without its holes, at the wanted speed.
#pragma once

#include <chrono>
#include <limits>
#include <optional>

namespace vespscope::sources {

struct PlaybackOptions {
  static constexpr double maximum = std::numeric_limits<double>::infinity();

  double speed = 1;                   // recorded seconds for each second; `maximum`: as fast as it goes
  bool loop = false;                  // from the start again at the end
  std::chrono::nanoseconds start{0};  // what comes before is left out
  bool realGaps = false;              // holes are played as long as they were
};

class Playback {
 public:
  // A longer silence, or time that runs backwards, is played as this long.
  static constexpr std::chrono::seconds longestGap{10};
  // Between the last event and the first one of the next round.
  static constexpr std::chrono::seconds loopGap{1};

  explicit Playback(const PlaybackOptions& options) : options_(options) {}

  // When the next event, which carries `time`, is played, from the start of playing; empty when it is left out.
  std::optional<std::chrono::nanoseconds> schedule(std::chrono::nanoseconds time);
  // The next event is the first one of another round.
  void restart();

 private:
  PlaybackOptions options_;
  std::optional<std::chrono::nanoseconds> lastTime_;
  std::chrono::nanoseconds position_{0};  // of the last event in this round, holes shortened
  std::chrono::nanoseconds played_{0};    // by earlier rounds
};

}  // namespace vespscope::sources
