// How current the values of a screen are. The event rate alone does not show this: one metric may have stopped.
#pragma once

#include <chrono>
#include <functional>
#include <optional>
#include <string>

namespace vespscope::application {

class ViewController;

struct ScreenAge {
  // Time since the newest report that the screen shows, in playback by the recording's own clock. Empty: no report yet.
  std::optional<std::chrono::nanoseconds> age;
  bool measurement =
      false;  // reported periodically, so an old value is out of date; a state holds until the next report
  // These values are no longer reported: the phone uses another technology, or the baseband manager is not connected.
  bool lastKnown = false;
};

enum class Freshness { none, current, old, lastKnown };

// Measurements arrive once a second while a cell serves, and at every paging cycle (at most 10.24 s in LTE, 3GPP TS
// 36.304 7.1) while the phone sleeps. If the newest is older than this, at least one is missing.
inline constexpr std::chrono::seconds oldAfter{15};
[[nodiscard]] Freshness freshnessOf(const ScreenAge& age);

// "updated now", "updated 3 s ago", "last known, 4 min ago"; empty before the first report.
[[nodiscard]] std::string screenAgeText(const ScreenAge& age);

// Returns the age of any screen; empty for a screen that shows no reports.
using ScreenAgeProvider = std::function<std::optional<ScreenAge>(const ViewController& screen)>;

}  // namespace vespscope::application
