// The talk with one modem on one connection: turns its log on step by step, and takes what it sends. Knows neither
// ports nor time: it is told of both.
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
    logging,  // the log is on, or comes without being asked for
    silent,   // no answer in time, nor any log
    garbled,  // bytes come, but none that a modem sends
    refused,  // the modem does not let its log be turned on
  };

  LogSession(Clock::time_point now, std::chrono::milliseconds patience);

  // Takes bytes from the modem, and appends the events they give.
  void take(std::span<const std::uint8_t> bytes, Clock::time_point now, std::deque<MetricEvent>& events);
  // Lets the time pass.
  void tick(Clock::time_point now);

  [[nodiscard]] State state() const { return state_; }
  // When to tick next, if nothing comes before.
  [[nodiscard]] std::optional<Clock::time_point> deadline() const;
  // What is to be sent; the caller takes it away.
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
