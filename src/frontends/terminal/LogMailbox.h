// Passes log lines from the logging threads to the drawing one.
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
  // More lines than this that were not taken, or more than lastLinesByteCapacity, replace the oldest ones.
  static constexpr std::size_t capacity = log::lastLinesCapacity;

  // Safe from any thread.
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
  log::TextRing texts_;        // the texts of the lines
  std::uint64_t numbers_ = 0;  // assigned to lines so far
};

}  // namespace vespscope::terminal
