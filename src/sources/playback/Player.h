// Plays a stream of events as a running source, in its own timing or another.
#pragma once

#include <algorithm>
#include <chrono>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <stop_token>
#include <string>
#include <thread>
#include <vector>

#include "sources/playback/Playback.h"
#include "sources/playback/Source.h"

namespace vespscope::sources {

// The time that a player waits by; tests give another.
class PlayerClock {
 public:
  virtual ~PlayerClock() = default;
  // Begins to count.
  virtual void begin() = 0;
  // Waits until `moment`, counted from begin(); false when interrupted, before or meanwhile.
  virtual bool waitUntil(std::chrono::nanoseconds moment) = 0;
  // Ends all waiting for good. Safe from any thread.
  virtual void interrupt() = 0;
};

class SteadyPlayerClock final : public PlayerClock {
 public:
  // What comes this early is not waited for: many events that come close together wait once, not each by itself.
  static constexpr std::chrono::microseconds tolerance{200};
  // Who comes later than this, because the machine was busy or the program stopped, goes on as if he had come so late:
  // all that was due meanwhile, played in one go, would overrun the clients.
  static constexpr std::chrono::milliseconds longestDelay{20};
  // What of a delay the rest of the run is late by; negative delays are none.
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

class Player final : public Source {
 public:
  Player(std::unique_ptr<EventStream> stream, const PlaybackOptions& options,
         std::unique_ptr<PlayerClock> clock = std::make_unique<SteadyPlayerClock>());
  Player(const Player&) = delete;
  Player& operator=(const Player&) = delete;
  ~Player() override;

  [[nodiscard]] std::string label() const override { return label_; }
  [[nodiscard]] SourceKind kind() const override { return kind_; }
  void start(EventSink& sink) override;
  void stop() override;
  void findSimCardFiles(SimCardFilesHandler found) override;

 private:
  void run(EventSink& sink);
  bool rewind();

  // Shared with a thread that nobody has to join: it ends when it has found what there is, long before the player.
  struct Search {
    std::mutex mutex;
    std::condition_variable ended;
    bool goesOn = false;  // the thread may use the stream, and tells who waits
    std::stop_source stop;
    std::vector<SimCardFilesHandler> waiting;
  };
  static void search(Search& search, EventStream& stream);

  const std::string label_;
  const SourceKind kind_;
  const PlaybackOptions options_;
  const std::unique_ptr<PlayerClock> clock_;
  const std::unique_ptr<EventStream> stream_;  // plays on the thread, and is searched for SIM card files on another
  std::thread thread_;

  const std::shared_ptr<Search> search_ = std::make_shared<Search>();
};

}  // namespace vespscope::sources
