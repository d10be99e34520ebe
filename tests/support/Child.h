// A program run as a process of its own with descriptors, environment and limits as a test wants them.
#pragma once

#include <sys/resource.h>
#include <sys/types.h>

#include <array>
#include <chrono>
#include <filesystem>
#include <map>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "support/Process.h"

namespace vespscope::test {

struct ChildWish {
  std::filesystem::path program;
  std::vector<std::string> arguments = {};
  std::map<std::string, std::string> variables = {};  // beside the environment of this process
  // Descriptors of this process that become 0, 1 and 2 of the child; -1 leaves one closed.
  std::array<int, 3> descriptors = {-1, -1, -1};
  std::vector<std::pair<__rlimit_resource, rlim_t>> limits = {};
  std::filesystem::path folder = {};  // where it starts; empty: where this process is
  bool controllingTerminal = false;   // descriptor 0 becomes it
};

class Child {
 public:
  // The child leads a session of its own and dies with the thread that starts it. Where the program cannot be executed
  // it ends with status 127.
  explicit Child(const ChildWish& wish);
  Child(const Child&) = delete;
  Child& operator=(const Child&) = delete;
  // Kills the process if it still runs.
  ~Child();

  [[nodiscard]] pid_t identifier() const { return process_; }
  void signal(int number) const;
  [[nodiscard]] bool hasEnded() { return waitForEnd(std::chrono::milliseconds(0)).has_value(); }
  // Empty when it still runs after `limit`.
  [[nodiscard]] std::optional<ProcessEnd> waitForEnd(std::chrono::milliseconds limit);

 private:
  pid_t process_ = -1;
  std::optional<ProcessEnd> end_;
};

// "status 2" or "signal 11".
[[nodiscard]] std::string wordsOf(const ProcessEnd& end);

}  // namespace vespscope::test
