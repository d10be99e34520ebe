// Collects the lines printed on standard output while it lives.
#pragma once

#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "platform/log/Log.h"

namespace vespscope::test {

class OutputLines {
 public:
  OutputLines()
      : observation_([this](log::Channel channel, std::string_view line) {
          if (channel == log::Channel::standardOutput) lines_.emplace_back(line);
        }) {}

  // The lines since the last call.
  std::vector<std::string> take() { return std::exchange(lines_, {}); }

 private:
  std::vector<std::string> lines_;
  log::Observation observation_;
};

}  // namespace vespscope::test
