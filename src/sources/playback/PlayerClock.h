// The clock of a player.
#pragma once

#include <algorithm>
#include <chrono>
#include <condition_variable>
#include <mutex>

namespace vespscope::sources {

class PlayerClock {
 public:
  virtual ~PlayerClock() = default;
  // Sets the origin of moments to now.
  virtual void begin() = 0;
  // Waits until `moment`, which is from 0 to Playback::latestMoment; returns at once when it has passed. For a late
  // caller a clock may move its origin: all later moments are then delayed by the same amount. Returns false when the
  // clock was interrupted, before the call or during it.
  virtual bool waitUntil(std::chrono::nanoseconds moment) = 0;
  // Ends all waiting permanently. Safe from any thread.
  virtual void interrupt() = 0;
};

// Real time. Catches up with delays of up to `longestDelay`; moves its origin by the rest of a longer one.
class SteadyPlayerClock final : public PlayerClock {
 public:
  // Does not wait for a moment this close: events in quick succession wait once together.
  static constexpr std::chrono::microseconds tolerance{200};
  // A longer delay (a busy machine, a stopped program) is not caught up with: playing everything that became due
  // meanwhile at once would overrun the clients.
  static constexpr std::chrono::milliseconds longestDelay{20};
  // Returns the part of a delay by which the origin moves; zero for a negative delay.
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
