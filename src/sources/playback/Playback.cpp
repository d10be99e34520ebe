#include "sources/playback/Playback.h"

#include <algorithm>

namespace vespscope::sources {

using std::chrono::nanoseconds;

std::optional<nanoseconds> Playback::schedule(nanoseconds time) {
  RecordedTime::Step step = recorded_.advance(time);
  if (recorded_.position() < options_.start) return std::nullopt;
  if (!started_) step = {.length = recorded_.position() - options_.start, .backwards = false};
  started_ = true;
  if (!options_.realGaps) step.length = step.backwards ? longestGap : std::min<nanoseconds>(step.length, longestGap);
  playing_ = saturatingSum(playing_, step.length);
  if (options_.speed == PlaybackOptions::maximum) return nanoseconds(0);
  const double moment = static_cast<double>(saturatingSum(played_, playing_).count()) / options_.speed;
  constexpr nanoseconds latest = latestMoment;
  if (moment >= static_cast<double>(latest.count())) return latest;
  return nanoseconds(static_cast<nanoseconds::rep>(moment));
}

void Playback::restart() {
  played_ = saturatingSum(played_, saturatingSum(playing_, loopGap));
  playing_ = nanoseconds(0);
  recorded_ = {};
  started_ = false;
}

}  // namespace vespscope::sources
