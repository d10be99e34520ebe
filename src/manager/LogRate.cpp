#include "manager/LogRate.h"

#include "platform/log/Log.h"

namespace vespscope::manager {

void LogRate::write(const std::string& line, Clock::time_point now) {
  const std::lock_guard lock(mutex_);
  finishPeriod(now);
  if (written_ == lineLimit) {
    ++omitted_;
    return;
  }
  if (written_ == 0) begin_ = now;
  ++written_;
  log::system(line);
}

std::optional<LogRate::Clock::time_point> LogRate::report(Clock::time_point now) {
  const std::lock_guard lock(mutex_);
  finishPeriod(now);
  if (omitted_ == 0) return std::nullopt;
  return begin_ + period;
}

void LogRate::finishPeriod(Clock::time_point now) {
  if (written_ == 0 || now < begin_ + period) return;
  if (omitted_ != 0) log::system(std::to_string(omitted_) + " more " + kind_ + " are not in the log");
  written_ = 0;
  omitted_ = 0;
}

}  // namespace vespscope::manager
