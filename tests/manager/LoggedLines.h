// Collects the log lines of a test.
#pragma once

#include <mutex>
#include <string>
#include <string_view>
#include <vector>

#include "platform/log/Log.h"

namespace vespscope::test {

// The lines logged while this object lives.
class LoggedLines {
 public:
  [[nodiscard]] std::vector<std::string> all() const {
    const std::lock_guard lock(mutex_);
    return lines_;
  }

 private:
  mutable std::mutex mutex_;
  std::vector<std::string> lines_;
  const log::Observation observation_{[this](log::Channel, std::string_view line) {
    const std::lock_guard lock(mutex_);
    lines_.emplace_back(line);
  }};
};

}  // namespace vespscope::test
