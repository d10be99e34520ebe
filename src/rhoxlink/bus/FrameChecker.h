// Checks what a peer sends before the bus library gathers messages from it: how large and how slow they may be.
//
// The library allocates the size that a message's header announces, up to 128 MiB, and waits for the rest without a
// timeout. The checker reads the headers first, so that neither happens.
#pragma once

#include <atomic>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>

#include "values/Result.h"

namespace vespscope::bus {

// A message with a megabyte of data, and its other parts.
inline constexpr std::size_t messageLimit = (std::size_t{1} << 20) + 4096;  // bytes, header and body

struct WireLimits {
  std::size_t authentication = 4096;   // bytes before the first message
  std::size_t message = messageLimit;  // bytes, header and body
  std::size_t fields = 4096;           // bytes of the header's fields: names, path, signature
  std::size_t unbudgeted = 64 * 1024;  // bytes; a larger message needs space in the budget
  std::chrono::milliseconds authenticationTime{10'000};
  std::chrono::milliseconds messageTime{30'000};  // from a message's first byte to its last
  bool calls = true;                              // the peer may call methods

  // For the client's end: the manager does not call it, and a manager that is reached through another machine may be
  // slow to answer.
  static constexpr WireLimits ofClient() {
    WireLimits limits;
    limits.authenticationTime = std::chrono::minutes(2);
    limits.calls = false;
    return limits;
  }
};

// Memory shared by the large messages of several connections. Safe from any thread.
class MemoryBudget {
 public:
  explicit MemoryBudget(std::size_t limit) : limit_(limit) {}
  // Takes `size` bytes; returns false when they are not available.
  bool take(std::size_t size);
  void giveBack(std::size_t size) { taken_ -= size; }
  [[nodiscard]] std::size_t taken() const { return taken_; }

 private:
  const std::size_t limit_;
  std::atomic<std::size_t> taken_ = 0;
};

class FrameChecker {
 public:
  // Without a budget, large messages do not wait.
  explicit FrameChecker(const WireLimits& limits, std::shared_ptr<MemoryBudget> budget = nullptr)
      : limits_(limits), budget_(std::move(budget)) {}
  FrameChecker(const FrameChecker&) = delete;
  FrameChecker& operator=(const FrameChecker&) = delete;
  ~FrameChecker() { finishMessage(); }

  // Returns how many of `bytes`, the next ones of the stream, may be passed on now, or why the peer is rejected.
  // `authenticated` is the library's state after it has read all bytes passed on before. Until it is true, this returns
  // at most one line, so that both agree on where the first message begins.
  Result<std::size_t> admit(std::span<const std::uint8_t> bytes, bool authenticated);

  // Records a wait without data from the peer; returns an error when the peer is rejected for it.
  Result<bool> waited(std::chrono::milliseconds duration);
  // Whether the end of the peer's authentication or of a message is still missing.
  [[nodiscard]] bool unfinished() const { return !authenticated_ || begun_; }
  // Whether the next message waits for space in the budget.
  [[nodiscard]] bool waitsForRoom() const { return waitsForRoom_; }

 private:
  Result<std::size_t> admitLine(std::span<const std::uint8_t> bytes);
  Result<std::size_t> admitMessages(std::span<const std::uint8_t> bytes);
  // The size of the message with this header, in bytes.
  [[nodiscard]] Result<std::size_t> sizeOf(std::span<const std::uint8_t> header) const;
  void finishMessage();

  const WireLimits limits_;
  const std::shared_ptr<MemoryBudget> budget_;
  bool authenticated_ = false;
  std::size_t authenticationBytes_ = 0;
  bool begun_ = false;         // a message has begun
  std::size_t remaining_ = 0;  // its bytes that have not been passed on
  std::size_t taken_ = 0;      // of the budget
  bool waitsForRoom_ = false;
  std::chrono::milliseconds waited_{0};  // for the authentication, or for this message
};

}  // namespace vespscope::bus
