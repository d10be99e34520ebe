#include "sources/OneSimStream.h"

#include "messages/DataBearers.h"

namespace vespscope::sources {

std::optional<MetricEvent> OneSimStream::next() {
  while (auto event = all_->next()) {
    if (passes(*event)) return event;
  }
  return std::nullopt;
}

std::optional<MetricEvent> OneSimStream::simCardFiles(std::stop_token stop) {
  auto files = all_->simCardFiles(std::move(stop));
  return files && passes(*files) ? std::move(files) : std::nullopt;
}

// Looks at the beginning only, so that a long recording starts at once.
std::optional<std::int32_t> simCardOfData(EventStream& stream) {
  if (!stream.canRewind()) return std::nullopt;
  constexpr int mostEvents = 50'000;
  std::optional<std::int32_t> first;
  std::optional<std::int32_t> withBearers;
  bool several = false;
  for (int count = 0; count < mostEvents && !(several && withBearers); ++count) {
    const auto event = stream.next();
    if (!event) break;
    if (event->profileID == 0) continue;
    if (!first) first = event->profileID;
    several = several || event->profileID != *first;
    if (!withBearers && reportsDataBearers(event->metricID, event->payload)) withBearers = event->profileID;
  }
  stream.rewind();
  return several ? withBearers : std::nullopt;
}

}  // namespace vespscope::sources
