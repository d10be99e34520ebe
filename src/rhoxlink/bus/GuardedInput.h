// Checks a peer's data before the bus library reads it: read from the peer's descriptor, passed on through a pipe.
#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <vector>

#include "rhoxlink/bus/FrameChecker.h"
#include "values/Result.h"

namespace vespscope::bus {

// Used by one thread; never blocks.
class GuardedInput {
 public:
  // Reads `input`, which it owns from here on, even on failure.
  static Result<std::unique_ptr<GuardedInput>> open(int input, const WireLimits& limits,
                                                    std::shared_ptr<MemoryBudget> budget);
  GuardedInput(const GuardedInput&) = delete;
  GuardedInput& operator=(const GuardedInput&) = delete;
  ~GuardedInput();

  // Returns the end of the pipe from which the library reads; the caller owns it.
  [[nodiscard]] int takeOutput();
  // Passes on the bytes that are allowed. Returns true when the library has something new to read, including the end;
  // false when the peer has to send more; an error when the peer is rejected. Call it when the library has read
  // everything passed on before.
  Result<bool> pump(bool authenticated);

  // Readable when pump() has work.
  [[nodiscard]] int descriptor() const { return input_; }
  [[nodiscard]] bool wantsInput() const { return !checker_.waitsForRoom() && !ended_; }
  // How long pump() need not be called if nothing becomes readable; negative: indefinitely.
  [[nodiscard]] std::chrono::microseconds timeout() const;

 private:
  using Clock = std::chrono::steady_clock;

  GuardedInput(int input, int reading, int writing, const WireLimits& limits, std::shared_ptr<MemoryBudget> budget);
  // Writes allowed bytes into the pipe as far as it accepts them; returns false when there are none, or it accepts
  // none.
  bool passOn();
  // Reads the peer's data; returns false when there is none.
  bool fill();
  Result<bool> waited();

  int input_;
  int reading_;
  int writing_;
  FrameChecker checker_;
  std::vector<std::uint8_t> buffer_;
  std::size_t begin_ = 0;     // of the bytes not passed on
  std::size_t admitted_ = 0;  // end of the bytes that may be passed on
  std::size_t end_ = 0;       // end of the bytes read
  bool ended_ = false;        // the peer has closed its end
  bool drained_ = false;      // the last read emptied the descriptor
  Clock::time_point lastWait_;
  bool waiting_ = false;  // since lastWait_
};

}  // namespace vespscope::bus
