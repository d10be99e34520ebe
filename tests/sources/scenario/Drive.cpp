#include "sources/scenario/Drive.h"

#include <algorithm>
#include <optional>
#include <string>
#include <unordered_map>

#include "messages/MessageClasses.h"
#include "messages/WireReader.h"
#include "registry/MetricRows.h"
#include "sources/scenario/ScenarioStream.h"

namespace vespscope::test {
namespace {

using namespace sources;

const MetricRow* rowOf(const MetricEvent& event) {
  const auto* row = std::find_if(metricRows.begin(), metricRows.end(),
                                 [&](const MetricRow& each) { return each.identifier() == event.metricID; });
  return row == metricRows.end() ? nullptr : row;
}

// The registry spells some class names differently.
std::string className(std::string_view registryText) {
  if (registryText == "KCellularRsrpRsrqSinr") return "KCellularLteRsrpRsrqSinr";
  std::string name(registryText);
  name.front() = 'K';
  return name;
}

using Makers = std::unordered_map<std::int32_t, std::shared_ptr<WireMessage> (*)()>;

Makers makersByIdentifier() {
  Makers makers;
  for (const MetricRow& row : metricRows) {
    for (const MessageClass& each : messageClasses()) {
      if (each.name == className(row.registryText)) makers.emplace(row.identifier(), each.make);
    }
  }
  return makers;
}

}  // namespace

std::vector<MetricEvent> driveOf(std::uint64_t seed, std::chrono::milliseconds length) {
  const std::unique_ptr<EventStream> stream = makeScenarioStream(seed, driveStart);
  std::vector<MetricEvent> events;
  while (true) {
    std::optional<MetricEvent> event = stream->next();
    if (!event || event->time - driveStart >= length) return events;
    events.push_back(std::move(*event));
  }
}

std::chrono::milliseconds sinceStart(const MetricEvent& event) {
  return std::chrono::floor<std::chrono::milliseconds>(event.time - driveStart);
}

std::shared_ptr<WireMessage> decoded(const MetricEvent& event) {
  static const Makers makers = makersByIdentifier();
  const auto maker = makers.find(event.metricID);
  if (maker == makers.end()) return nullptr;
  std::shared_ptr<WireMessage> message = maker->second();
  WireReader reader(event.payload);
  return message->readFrom(reader) ? message : nullptr;
}

std::string_view metricName(const MetricEvent& event) {
  const MetricRow* row = rowOf(event);
  return row == nullptr ? std::string_view() : row->identifierName;
}

std::set<std::string_view> metricNames(const std::vector<MetricEvent>& events) {
  std::set<std::string_view> names;
  for (const MetricEvent& event : events) names.insert(metricName(event));
  return names;
}

}  // namespace vespscope::test
