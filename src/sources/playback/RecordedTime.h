// A recording's own time, counted from its first event with every silence as long as it was.
#pragma once

#include <chrono>
#include <optional>
#include <stop_token>

namespace vespscope::sources {

class EventStream;

// Nanoseconds that stop at the largest or smallest value instead of overflowing.
[[nodiscard]] std::chrono::nanoseconds saturatingSum(std::chrono::nanoseconds one, std::chrono::nanoseconds other);
[[nodiscard]] std::chrono::nanoseconds saturatingDifference(std::chrono::nanoseconds from,
                                                            std::chrono::nanoseconds subtracted);

class RecordedTime {
 public:
  struct Step {
    std::chrono::nanoseconds length{0};  // since the event before; zero for the first one
    bool backwards = false;              // its time is before that event's, which counts as no time
  };

  // Moves to the next event, which carries `time`.
  Step advance(std::chrono::nanoseconds time);
  // Of the last event; zero before the first.
  [[nodiscard]] std::chrono::nanoseconds position() const { return position_; }
  // What the last event carries; empty before the first.
  [[nodiscard]] std::optional<std::chrono::nanoseconds> lastTime() const { return lastTime_; }

 private:
  std::optional<std::chrono::nanoseconds> lastTime_;
  std::chrono::nanoseconds position_{0};
};

// Pulls all events that are left of `stream` and returns the time between the first and the last one, or empty when
// `stop` was requested before the end.
[[nodiscard]] std::optional<std::chrono::nanoseconds> lengthOf(EventStream& stream, const std::stop_token& stop);

}  // namespace vespscope::sources
