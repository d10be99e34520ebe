#include "sources/playback/StateBefore.h"

#include <algorithm>

namespace vespscope::sources {

void StateBefore::take(MetricEvent event) {
  const std::pair key{event.metricID, event.profileID};
  if (const auto old = latest_.find(key); old != latest_.end()) {
    bytes_ -= old->second.event.payload.size();
    latest_.erase(old);
  }
  if (latest_.size() >= metricLimit || event.payload.size() > byteLimit - bytes_) {
    ++leftOut_;
    return;
  }
  bytes_ += event.payload.size();
  latest_[key] = {++taken_, std::move(event)};
}

std::vector<MetricEvent> StateBefore::release() {
  std::vector<Entry> entries;
  entries.reserve(latest_.size());
  for (auto& [key, entry] : latest_) entries.push_back(std::move(entry));
  std::sort(entries.begin(), entries.end(),
            [](const Entry& one, const Entry& other) { return one.number < other.number; });
  std::vector<MetricEvent> events;
  events.reserve(entries.size());
  for (Entry& entry : entries) events.push_back(std::move(entry.event));
  *this = {};
  return events;
}

}  // namespace vespscope::sources
