// Shows a waiting user how far a long command is, on a terminal's standard error and nowhere else.
#pragma once

#include <chrono>
#include <cstdint>
#include <string>

#include "sources/playback/Source.h"

namespace vespscope::tools {

// "12.3 of 45.6 MB, 8.1 MB/s, 4 s left, 1234 events": what of the input was read in `elapsed`. Without a total there is
// no time left, and without any input only the events.
[[nodiscard]] std::string progressText(const sources::InputProgress& input, std::uint64_t events,
                                       std::chrono::milliseconds elapsed);

class Progress {
 public:
  Progress();
  Progress(const Progress&) = delete;
  Progress& operator=(const Progress&) = delete;
  // Removes the line that shows the progress.
  ~Progress();

  // A line that stays.
  void say(const std::string& line);
  // Whether a line is due, at most five in a second.
  [[nodiscard]] bool due();
  // Shows a line over the one shown before.
  void show(const std::string& line);
  // Since the beginning.
  [[nodiscard]] std::chrono::milliseconds elapsed() const;

 private:
  void clear();

  const bool onTerminal_;
  const std::chrono::steady_clock::time_point begin_ = std::chrono::steady_clock::now();
  bool shown_ = false;
  std::chrono::steady_clock::time_point next_{};
};

}  // namespace vespscope::tools
