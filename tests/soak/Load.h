// The simulated drive's events as a load on managers: as fast as they go or as fast as they are taken, and counted.
#pragma once

#include <condition_variable>
#include <cstdint>
#include <memory>
#include <mutex>

#include "sources/playback/Source.h"

namespace vespscope::test {

class Load {
 public:
  Load(std::uint64_t seed, std::uint64_t total);

  // A source of what is left; one at a time may run, and the load outlives it.
  [[nodiscard]] std::unique_ptr<sources::Source> makeSource();

  // Returns when no event is on its way to a manager, and none follows until resume().
  void pause();
  void resume();
  // Whether events wait until those before have been taken, or come as fast as they can be made.
  void setPaced(bool paced);
  // Reports that so many have been handled since the start.
  void setTaken(std::uint64_t taken);

  [[nodiscard]] std::uint64_t sent() const;
  [[nodiscard]] bool isOver() const { return sent() >= total_; }

 private:
  class FromLoad;
  static constexpr std::uint64_t lead = 1500;  // events that a paced load is ahead

  [[nodiscard]] bool mayGoOn() const { return !paused_ && (!paced_ || sent_ < taken_ + lead); }

  const std::uint64_t total_;
  mutable std::mutex mutex_;
  std::condition_variable changed_;
  std::unique_ptr<sources::EventStream> stream_;
  std::uint64_t sent_ = 0;
  std::uint64_t taken_ = 0;
  bool paused_ = false;
  bool paced_ = false;
  bool delivering_ = false;
};

}  // namespace vespscope::test
