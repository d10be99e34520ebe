// A recording's own time, counted from its first event without shortening any gap.
#pragma once

#include <chrono>
#include <optional>
#include <stop_token>

namespace vespscope::sources {

class EventStream;

// Nanoseconds that saturate instead of overflowing.
[[nodiscard]] std::chrono::nanoseconds saturatingSum(std::chrono::nanoseconds one, std::chrono::nanoseconds other);
[[nodiscard]] std::chrono::nanoseconds saturatingDifference(std::chrono::nanoseconds from,
                                                            std::chrono::nanoseconds subtracted);

class RecordedTime {
 public:
  struct Step {
    std::chrono::nanoseconds length{0};  // since the previous event; zero for the first one
    bool backwards = false;              // its time is before the previous event's, which counts as no time
  };

  // Moves to the next event, recorded at `time`.
  Step advance(std::chrono::nanoseconds time);
  // The position of the last event; zero before the first.
  [[nodiscard]] std::chrono::nanoseconds position() const { return position_; }
  // The time of the last event; empty before the first.
  [[nodiscard]] std::optional<std::chrono::nanoseconds> lastTime() const { return lastTime_; }

 private:
  std::optional<std::chrono::nanoseconds> lastTime_;
  std::chrono::nanoseconds position_{0};
};

// Reads all remaining events of `stream` and returns the time between the first and the last one; empty when `stop` was
// requested before the end.
[[nodiscard]] std::optional<std::chrono::nanoseconds> lengthOf(EventStream& stream, const std::stop_token& stop);

}  // namespace vespscope::sources
