// What a peer sends, checked on its way to the bus library: read from the peer's descriptor, passed on through a pipe.
#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <vector>

#include "rhoxlink/bus/FrameChecker.h"
#include "values/Result.h"

namespace vespscope::bus {

// Belongs to one thread and never waits.
class GuardedInput {
 public:
  // Reads `input`, which it owns from here on, even when this fails.
  static Result<std::unique_ptr<GuardedInput>> open(int input, const WireLimits& limits,
                                                    std::shared_ptr<MemoryBudget> budget);
  GuardedInput(const GuardedInput&) = delete;
  GuardedInput& operator=(const GuardedInput&) = delete;
  ~GuardedInput();

  // The end of the pipe from which the library reads; the caller owns it.
  [[nodiscard]] int takeOutput();
  // Passes on what may be passed on. True when the library has something new to read, its end included; false when the
  // peer must be waited for; else why the peer is refused. Call it when the library has read all that was passed on.
  Result<bool> pump(bool authenticated);

  // Readable when pump() has something to do.
  [[nodiscard]] int descriptor() const { return input_; }
  [[nodiscard]] bool wantsInput() const { return !checker_.waitsForRoom() && !ended_; }
  // How long pump() need not be called although nothing is readable; negative: for ever.
  [[nodiscard]] std::chrono::microseconds timeout() const;

 private:
  using Clock = std::chrono::steady_clock;

  GuardedInput(int input, int reading, int writing, const WireLimits& limits, std::shared_ptr<MemoryBudget> budget);
  // Writes admitted bytes into the pipe as far as it takes them; false when there are none, or it takes none.
  bool passOn();
  // Reads what the peer has sent; false when nothing has come.
  bool fill();
  Result<bool> waited();

  int input_;
  int reading_;
  int writing_;
  FrameChecker checker_;
  std::vector<std::uint8_t> buffer_;
  std::size_t begin_ = 0;     // of what has not been passed on
  std::size_t admitted_ = 0;  // the end of what may be passed on
  std::size_t end_ = 0;       // of what has been read
  bool ended_ = false;        // the peer sends no more
  bool drained_ = false;      // the last read left nothing
  Clock::time_point lastWait_;
  bool waiting_ = false;  // since lastWait_
};

}  // namespace vespscope::bus
