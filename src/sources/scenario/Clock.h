// Time within a simulated drive: a moment, a timer, a condition that must last.
#pragma once

#include <chrono>
#include <optional>

namespace vespscope::sources::scenario {

using Time = std::chrono::milliseconds;  // since the drive began

// The drive advances by LTE radio frames (3GPP TS 36.211 4.1).
inline constexpr Time frame{10};

class Timer {
 public:
  void start(Time now, Time after) { at_ = now + after; }
  void stop() { at_.reset(); }
  [[nodiscard]] bool running() const { return at_.has_value(); }
  // Returns true once, when the timer has expired.
  [[nodiscard]] bool expired(Time now) {
    if (!at_ || now < *at_) return false;
    at_.reset();
    return true;
  }

 private:
  std::optional<Time> at_;
};

// Detects that a condition has held without a break for long enough, as a time-to-trigger requires.
class Lasting {
 public:
  [[nodiscard]] bool holds(bool condition, Time now, Time needed) {
    if (!condition) {
      since_.reset();
      return false;
    }
    if (!since_) since_ = now;
    return now - *since_ >= needed;
  }
  void reset() { since_.reset(); }

 private:
  std::optional<Time> since_;
};

}  // namespace vespscope::sources::scenario
