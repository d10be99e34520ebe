// Events per second over the last seconds, from a growing count.
#pragma once

#include <chrono>
#include <cstdint>
#include <deque>

namespace vespscope {

class EventRate {
 public:
  using Clock = std::chrono::steady_clock;

  // Records that `events` had been counted by `now`; returns the rate since the oldest count of the last five seconds,
  // or 0 if there is no earlier one. Time and count must not decrease.
  double update(Clock::time_point now, std::uint64_t events);

 private:
  struct Sample {
    Clock::time_point time;
    std::uint64_t events;
  };
  std::deque<Sample> samples_;
};

}  // namespace vespscope
