// Tells a waiting user how far a long command is, on a terminal's standard error and nowhere else.
#pragma once

#include <chrono>
#include <cstdint>
#include <string>

namespace vespscope::tools {

class Progress {
 public:
  Progress();
  Progress(const Progress&) = delete;
  Progress& operator=(const Progress&) = delete;
  // Clears the line that shows the count.
  ~Progress();

  // A line that stays.
  void say(const std::string& line);
  // Shows the count now and then, over the one shown before.
  void show(std::uint64_t events);

 private:
  void clear();

  const bool onTerminal_;
  bool shown_ = false;
  std::chrono::steady_clock::time_point next_{};
};

}  // namespace vespscope::tools
