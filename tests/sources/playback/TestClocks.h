// Clocks that a test controls, for players.
#pragma once

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <utility>
#include <vector>

#include "sources/playback/PlayerClock.h"
#include "sources/playback/Source.h"

namespace vespscope::test {

// A clock that advances only when the test says so.
class TestClock final : public sources::PlayerClock {
 public:
  struct State {
    std::mutex mutex;
    std::condition_variable changed;
    std::chrono::nanoseconds now{0};
    bool interrupted = false;

    void advanceTo(std::chrono::nanoseconds moment) {
      {
        const std::lock_guard lock(mutex);
        now = moment;
      }
      changed.notify_all();
    }
  };
  explicit TestClock(std::shared_ptr<State> state) : state_(std::move(state)) {}

  void begin() override {}
  bool waitUntil(std::chrono::nanoseconds moment) override {
    std::unique_lock lock(state_->mutex);
    state_->changed.wait(lock, [&] { return state_->interrupted || state_->now >= moment; });
    return !state_->interrupted;
  }
  void interrupt() override {
    {
      const std::lock_guard lock(state_->mutex);
      state_->interrupted = true;
    }
    state_->changed.notify_all();
  }

 private:
  std::shared_ptr<State> state_;
};

// The played events with their times; a clock on which any moment comes at once.
struct Played {
  std::vector<std::pair<int, std::chrono::nanoseconds>> events;
  std::chrono::nanoseconds now{0};
  std::atomic<std::size_t> count = 0;
  std::atomic<bool> full = false;
};

class InstantClock final : public sources::PlayerClock {
 public:
  explicit InstantClock(Played& played) : played_(played) {}
  void begin() override {}
  bool waitUntil(std::chrono::nanoseconds moment) override {
    played_.now = moment;
    return !played_.full;
  }
  void interrupt() override { played_.full = true; }

 private:
  Played& played_;
};

// Stores the first `limit` events.
class PlayedSink final : public sources::EventSink {
 public:
  PlayedSink(Played& played, std::size_t limit) : played_(played), limit_(limit) {}
  void deliver(MetricEvent event) override {
    if (played_.full) return;
    played_.events.emplace_back(event.payload.at(0), played_.now);
    if (++played_.count == limit_) played_.full = true;
  }

 private:
  Played& played_;
  std::size_t limit_;
};

}  // namespace vespscope::test
