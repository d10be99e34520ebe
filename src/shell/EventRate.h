// Events per second over the last seconds, from a count that only grows.
#pragma once

#include <chrono>
#include <cstdint>
#include <deque>

namespace vespscope {

class EventRate {
 public:
  using Clock = std::chrono::steady_clock;

  // Notes that `events` had been counted by `now`; returns the rate since the oldest count of the last five seconds, 0
  // while there is no earlier one. Time and count must not go back.
  double update(Clock::time_point now, std::uint64_t events);

 private:
  struct Sample {
    Clock::time_point time;
    std::uint64_t events;
  };
  std::deque<Sample> samples_;
};

}  // namespace vespscope
