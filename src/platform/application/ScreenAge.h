// How current the values of a screen are, which says more than how well the events flow: a metric may have stopped.
#pragma once

#include <chrono>
#include <functional>
#include <optional>
#include <string>

namespace vespscope::application {

class ViewController;

struct ScreenAge {
  // Since the newest report that the screen shows; in playback on the recording's own clock. Empty: none came yet.
  std::optional<std::chrono::nanoseconds> age;
  bool measurement =
      false;  // reported again and again, so that an old one is out of date; a state holds until the next
  // Nothing reports these values any more: the phone uses another technology, or the baseband manager is not connected.
  bool lastKnown = false;
};

enum class Freshness { none, current, old, lastKnown };

// Measurements come once a second while a cell serves, and at every paging cycle (at most 10.24 s in LTE, 3GPP TS
// 36.304 7.1) while the phone sleeps: older than this, one or more are missing.
inline constexpr std::chrono::seconds oldAfter{15};
[[nodiscard]] Freshness freshnessOf(const ScreenAge& age);

// "updated now", "updated 3 s ago", "last known, 4 min ago"; empty when no report came yet.
[[nodiscard]] std::string screenAgeText(const ScreenAge& age);

// Answers for any screen; empty for one that shows no reports.
using ScreenAgeProvider = std::function<std::optional<ScreenAge>(const ViewController& screen)>;

}  // namespace vespscope::application
