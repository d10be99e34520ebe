// The simulated drive's events as a load on managers: as fast as possible, or as fast as they are processed, and
// counted.
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

  // A source of the remaining events; only one may run at a time, and the load must outlive it.
  [[nodiscard]] std::unique_ptr<sources::Source> makeSource();

  // Returns when no event is in transit to a manager, and sends none until resume().
  void pause();
  void resume();
  // Whether events wait until earlier ones have been processed, or are sent as fast as possible.
  void setPaced(bool paced);
  // Reports the number of events processed since the start.
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
