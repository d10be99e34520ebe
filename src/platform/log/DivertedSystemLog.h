// Keeps the system log's lines of one thread for whoever asked for the work that logs them.
#pragma once

#include <functional>
#include <string_view>

namespace vespscope::log {

// While the object lives, log::system() on the thread that made it calls the function instead of logging; with an empty
// function the lines are lost. Observers do not receive them. Objects nest: the innermost one counts. The function
// must outlive the object.
class DivertedSystemLog {
 public:
  using Lines = std::function<void(std::string_view line)>;

  explicit DivertedSystemLog(const Lines& lines);
  DivertedSystemLog(const DivertedSystemLog&) = delete;
  DivertedSystemLog& operator=(const DivertedSystemLog&) = delete;
  ~DivertedSystemLog();

 private:
  const Lines* outer_;
};

}  // namespace vespscope::log
