// Shows the progress of a long command, only if standard error is a terminal.
#pragma once

#include <chrono>
#include <cstdint>
#include <string>

#include "sources/playback/Source.h"

namespace vespscope::tools {

// "12.3 of 45.6 MB, 8.1 MB/s, 4 s left, 1234 events": the input read in `elapsed`. Without a total there is no
// remaining time; without any input there are only the events.
[[nodiscard]] std::string progressText(const sources::InputProgress& input, std::uint64_t events,
                                       std::chrono::milliseconds elapsed);

class Progress {
 public:
  Progress();
  Progress(const Progress&) = delete;
  Progress& operator=(const Progress&) = delete;
  // Removes the progress line.
  ~Progress();

  // Prints a line that stays.
  void say(const std::string& line);
  // Whether a new line should be shown: at most five times a second.
  [[nodiscard]] bool due();
  // Replaces the progress line.
  void show(const std::string& line);
  // The time since the beginning.
  [[nodiscard]] std::chrono::milliseconds elapsed() const;

 private:
  void clear();

  const bool onTerminal_;
  const std::chrono::steady_clock::time_point begin_ = std::chrono::steady_clock::now();
  bool shown_ = false;
  std::chrono::steady_clock::time_point next_{};
};

}  // namespace vespscope::tools
