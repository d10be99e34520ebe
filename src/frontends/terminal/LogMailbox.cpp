#include "frontends/terminal/LogMailbox.h"

#include <utility>

namespace vespscope::terminal {

void LogMailbox::post(log::Channel channel, std::string_view text, std::chrono::system_clock::time_point time) {
  const std::lock_guard lock(mutex_);
  lines_.push_back({posted_++, time, channel, std::string(text)});
  if (lines_.size() > capacity) lines_.pop_front();
}

bool LogMailbox::empty() const {
  const std::lock_guard lock(mutex_);
  return lines_.empty();
}

std::deque<LogLine> LogMailbox::take() {
  std::deque<LogLine> taken;
  const std::lock_guard lock(mutex_);
  taken.swap(lines_);
  return taken;
}

}  // namespace vespscope::terminal
