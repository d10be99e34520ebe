#include "frontends/terminal/LogMailbox.h"

namespace vespscope::terminal {
namespace {

// Lines of usual length need half of this; one of a megabyte is rare, and its memory is not kept.
constexpr std::size_t keptBytes = std::size_t{2} << 20;

}  // namespace

void LogMailbox::post(log::Channel channel, std::string_view text, std::chrono::system_clock::time_point time) {
  const std::lock_guard lock(mutex_);
  while (!posted_.empty() && (posted_.size() >= capacity || texts_.size() + text.size() > log::lastLinesByteCapacity)) {
    dropOldest();
  }
  posted_.push_back({time, channel, text.size()});
  texts_.push(text);
  ++numbers_;
}

void LogMailbox::dropOldest() {
  texts_.drop(posted_.front().size);
  posted_.pop_front();
}

bool LogMailbox::empty() const {
  const std::lock_guard lock(mutex_);
  return posted_.empty();
}

std::deque<LogLine> LogMailbox::take() {
  const std::lock_guard lock(mutex_);
  std::deque<LogLine> lines;
  std::uint64_t number = numbers_ - posted_.size();
  for (const Posted& next : posted_) lines.push_back({number++, next.time, next.channel, texts_.pop(next.size)});
  posted_.clear();
  texts_.shrink(keptBytes);
  return lines;
}

}  // namespace vespscope::terminal
