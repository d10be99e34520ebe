#include "frontends/terminal/LogMailbox.h"

namespace vespscope::terminal {

void LogMailbox::post(log::Channel channel, std::string_view text, std::chrono::system_clock::time_point time) {
  const std::lock_guard lock(mutex_);
  lines_.push({posted_++, time, channel, std::string(text)});
}

bool LogMailbox::empty() const {
  const std::lock_guard lock(mutex_);
  return lines_.empty();
}

std::deque<LogLine> LogMailbox::take() {
  const std::lock_guard lock(mutex_);
  return lines_.take();
}

}  // namespace vespscope::terminal
