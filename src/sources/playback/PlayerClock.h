// The time that a player waits by.
#pragma once

#include <algorithm>
#include <chrono>
#include <condition_variable>
#include <mutex>

namespace vespscope::sources {

class PlayerClock {
 public:
  virtual ~PlayerClock() = default;
  // Sets the zero that moments count from.
  virtual void begin() = 0;
  // Waits until `moment`, which is from 0 to Playback::latestMoment, and returns at once when that has passed. A clock
  // may answer a caller that comes late by moving its zero: all later moments are then that much later. Returns false
  // when the clock was interrupted, before the call or during it.
  virtual bool waitUntil(std::chrono::nanoseconds moment) = 0;
  // Ends all waiting for good. Safe from any thread.
  virtual void interrupt() = 0;
};

// Real time. Makes up for delays of up to `longestDelay` and moves its zero by the rest of a longer one.
class SteadyPlayerClock final : public PlayerClock {
 public:
  // It does not wait for a moment this close: events that come close together wait once, not each by itself.
  static constexpr std::chrono::microseconds tolerance{200};
  // A longer delay (a busy machine, a stopped program) is not made up for: playing everything that was due meanwhile
  // at once would overrun the clients.
  static constexpr std::chrono::milliseconds longestDelay{20};
  // The part of a delay by which the zero moves; a negative delay is none.
  static constexpr std::chrono::nanoseconds notMadeUpFor(std::chrono::nanoseconds delay) {
    return std::max<std::chrono::nanoseconds>(delay - longestDelay, std::chrono::nanoseconds(0));
  }

  void begin() override { begin_ = std::chrono::steady_clock::now(); }
  bool waitUntil(std::chrono::nanoseconds moment) override;
  void interrupt() override;

 private:
  std::mutex mutex_;
  std::condition_variable changed_;
  bool interrupted_ = false;
  std::chrono::steady_clock::time_point begin_;
};

}  // namespace vespscope::sources
