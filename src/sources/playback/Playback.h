// When each event of a stream is played: at its recorded time, with shortened gaps, at the wanted speed.
#pragma once

#include <chrono>
#include <limits>
#include <optional>

#include "sources/playback/RecordedTime.h"

namespace vespscope::sources {

struct PlaybackOptions {
  static constexpr double maximum = std::numeric_limits<double>::infinity();

  double speed = 1;                   // recorded seconds per second; `maximum`: as fast as possible
  bool loop = false;                  // start again at the end
  std::chrono::nanoseconds start{0};  // in the recording's own time; earlier events are not played
  bool realGaps = false;              // do not shorten gaps
};

class Playback {
 public:
  // A longer silence, or time that runs backwards, is played as this long.
  static constexpr std::chrono::seconds longestGap{10};
  // Between the last event and the first one of the next round.
  static constexpr std::chrono::seconds loopGap{1};
  // No event is played later than this, whatever its time and the speed, so that adding the moment to a clock cannot
  // overflow.
  static constexpr std::chrono::hours latestMoment{24 * 365 * 100};

  explicit Playback(const PlaybackOptions& options) : options_(options) {}

  // Returns when the next event, recorded at `time`, is played, from the start of playing and at most latestMoment;
  // empty for an event before the start.
  std::optional<std::chrono::nanoseconds> schedule(std::chrono::nanoseconds time);
  // Begins another round: the next event is the first one again.
  void restart();

  // The recording's own time at the last event that was scheduled.
  [[nodiscard]] const RecordedTime& recorded() const { return recorded_; }

 private:
  PlaybackOptions options_;
  RecordedTime recorded_;
  bool started_ = false;                 // an event of this round has been played
  std::chrono::nanoseconds playing_{0};  // position in this round at its last event, with shortened gaps
  std::chrono::nanoseconds played_{0};   // in earlier rounds
};

}  // namespace vespscope::sources
