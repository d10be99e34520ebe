// Hands log lines over from the threads that log to the one that draws.
#pragma once

#include <chrono>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <mutex>
#include <string>
#include <string_view>

#include "platform/log/LastLines.h"
#include "platform/log/Log.h"
#include "platform/log/TextRing.h"

namespace vespscope::terminal {

struct LogLine {
  std::uint64_t number = 0;  // counts all lines since the start
  std::chrono::system_clock::time_point time;
  log::Channel channel = log::Channel::systemLog;
  std::string text;
};

class LogMailbox {
 public:
  // Lines beyond this many that nobody has taken, or beyond lastLinesByteCapacity, replace the oldest ones.
  static constexpr std::size_t capacity = log::lastLinesCapacity;

  // From any thread.
  void post(log::Channel channel, std::string_view text, std::chrono::system_clock::time_point time);
  [[nodiscard]] bool empty() const;
  // The lines posted since the last call, oldest first.
  [[nodiscard]] std::deque<LogLine> take();

 private:
  struct Posted {
    std::chrono::system_clock::time_point time;
    log::Channel channel;
    std::size_t size;  // of its text
  };
  void dropOldest();

  mutable std::mutex mutex_;
  std::deque<Posted> posted_;
  log::TextRing texts_;        // theirs
  std::uint64_t numbers_ = 0;  // given to lines so far
};

}  // namespace vespscope::terminal
