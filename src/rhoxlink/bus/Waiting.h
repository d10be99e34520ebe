// What a thread waits for at once: descriptors, and the time at which it continues in any case.
#pragma once

#include <poll.h>

#include <chrono>
#include <optional>
#include <vector>

#include "rhoxlink/bus/Bus.h"

namespace vespscope::bus {

class Waiting {
 public:
  using Clock = std::chrono::steady_clock;

  // Ends the wait when the descriptor is ready for one of `events`, in the form of poll(2). Ignores a negative
  // descriptor.
  void add(int descriptor, short events);
  // Ends the wait with that of an end of the bus.
  void add(const Wait& wait);
  // Ends the wait after `limit` at the latest, or at once if that is negative.
  void atMost(std::chrono::nanoseconds limit);
  void until(Clock::time_point time) { atMost(time - Clock::now()); }

  // Returns when one of these is the case, never before; also when a signal is handled.
  void wait();

 private:
  std::vector<pollfd> ready_;
  std::optional<std::chrono::nanoseconds> limit_;  // empty: none
};

}  // namespace vespscope::bus
