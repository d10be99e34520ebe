// The dialogue with one modem on one connection: turns its log on step by step, and reads its data. Uses no port and no
// clock: the caller passes bytes and times.
#pragma once

#include <chrono>
#include <cstdint>
#include <deque>
#include <optional>
#include <span>
#include <vector>

#include "sources/diag/FrameMapper.h"
#include "sources/diag/FrameReader.h"
#include "sources/diag/LogCommands.h"

namespace vespscope::sources::diag {

class LogSession {
 public:
  using Clock = std::chrono::steady_clock;

  enum class State {
    asking,   // a command waits for its answer
    logging,  // the log is on, or arrives without a request
    silent,   // no answer in time, and no log
    garbled,  // bytes that no modem sends
    refused,  // the modem rejects the commands
  };

  LogSession(Clock::time_point now, std::chrono::milliseconds patience);

  // Takes bytes from the modem, and appends their events.
  void take(std::span<const std::uint8_t> bytes, Clock::time_point now, std::deque<MetricEvent>& events);
  // Updates the time.
  void tick(Clock::time_point now);

  [[nodiscard]] State state() const { return state_; }
  // When to tick next, if no bytes arrive earlier.
  [[nodiscard]] std::optional<Clock::time_point> deadline() const;
  // Returns the bytes to send and clears them.
  [[nodiscard]] Bytes takeOutput() { return std::exchange(output_, {}); }

 private:
  void answer(const LogAnswer& answer, Clock::time_point now);
  void turnOnNext(Clock::time_point now);
  void send(const Bytes& frame, Clock::time_point now);

  const std::chrono::milliseconds patience_;
  FrameReader frames_;
  FrameMapper mapper_;
  State state_ = State::asking;
  CodeCounts counts_{};
  std::size_t nextEquipment_ = 0;
  bool bytesCame_ = false;
  bool recordsCame_ = false;
  std::optional<Clock::time_point> deadline_;
  Bytes output_;
};

}  // namespace vespscope::sources::diag
