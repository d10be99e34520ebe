#include "tools/vespctl/ScreenCoverage.h"

#include <algorithm>
#include <memory>
#include <string_view>
#include <utility>

#include "screens/ScreenSources.h"
#include "screens/VespViewItems.h"

namespace vespscope::tools {
namespace {

bool isEmpty(const Value& value) {
  const std::string* text = value.asText();
  return value.isNull() || (text != nullptr && text->empty());
}

// Whether the record says more than when it was made, or that nothing has come yet.
bool saysSomething(const Record& record) {
  static constexpr std::string_view waiting = "Waiting for Update";
  return std::any_of(record.begin(), record.end(), [](const Entry& entry) {
    return entry.key.view() != "timestamp" && entry.key.view() != waiting && !isEmpty(entry.value);
  });
}

bool isFilled(const ScreenSource& source, const MetricValidator& decoder) {
  if (source.record != nullptr) {
    const Record* record = source.record(decoder);
    return record != nullptr && saysSomething(*record);
  }
  const RecordList& list = source.list(decoder);
  return std::any_of(list.begin(), list.end(), saysSomething);
}

}  // namespace

ScreenCoverage::ScreenCoverage() {
  const VespViewItems& catalogue = VespViewItems::shared();
  for (const std::string& launch : catalogue.launchViewItemNames) {
    for (const std::string& row : catalogue.firstLevelViewItems.at(launch)) {
      CoveredScreen screen{.launch = launch, .row = row};
      screen.source = screenSource(screen.key());
      if (screen.source != nullptr && screen.source->metric) screens_.push_back(std::move(screen));
    }
  }
}

void ScreenCoverage::take(const MetricEvent& event) {
  bool wanted = false;
  for (CoveredScreen& screen : screens_) {
    if (screen.source->metric != event.metricID) continue;
    ++screen.reports;
    wanted = wanted || !screen.filled;
  }
  if (!wanted) return;
  decoder_.metricsDidUpdate(std::make_shared<const Record>(Record{{Key(decoder_.metricIDKey), event.metricID},
                                                                  {Key(decoder_.payloadKey), event.payload},
                                                                  {Key(decoder_.profileIDKey), event.profileID}}));
  for (CoveredScreen& screen : screens_) {
    if (screen.source->metric == event.metricID && !screen.filled) screen.filled = isFilled(*screen.source, decoder_);
  }
}

std::size_t ScreenCoverage::filled() const {
  const auto count = std::count_if(screens_.begin(), screens_.end(), [](const auto& screen) { return screen.filled; });
  return static_cast<std::size_t>(count);
}

}  // namespace vespscope::tools
