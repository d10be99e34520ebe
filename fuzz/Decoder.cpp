// The decoder processes events, then a capture of the same events: both must end in the same state.
#include <memory>
#include <vector>

#include <nlohmann/json.hpp>

#include "Fuzz.h"
#include "MemoryFile.h"
#include "capture/CaptureReader.h"
#include "capture/CaptureWriter.h"
#include "metrics/MetricValidator.h"
#include "platform/log/Log.h"
#include "registry/MetricRows.h"
#include "tools/vespctl/Json.h"
#include "tools/vespctl/State.h"

using namespace vespscope;
using fuzz::require;

namespace {

std::vector<MetricEvent> eventsOf(fuzz::Input input) {
  std::vector<MetricEvent> events;
  while (!input.empty() && events.size() < 64) {
    const std::uint8_t selector = input.byte();
    const std::int32_t metric = selector < metricRows.size() ? metricRows[selector].identifier() : input.word() * 40;
    const auto payload = input.piece();
    events.push_back({metric, selector / 64, Bytes(payload.begin(), payload.end()), std::chrono::seconds(selector)});
  }
  return events;
}

std::string stateAfter(const std::vector<MetricEvent>& events) {
  MetricValidator validator;
  for (const MetricEvent& event : events) {
    validator.metricsDidUpdate(std::make_shared<const Record>(Record{{Key(validator.metricIDKey), event.metricID},
                                                                     {Key(validator.payloadKey), event.payload},
                                                                     {Key(validator.profileIDKey), event.profileID}}));
  }
  return tools::write(tools::stateOf(validator));
}

}  // namespace

int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
  log::discardOutputs();
  const std::vector<MetricEvent> events = eventsOf(fuzz::Input(data, size));
  const std::string direct = stateAfter(events);
  const fuzz::MemoryFile file;
  {
    auto writer = capture::CaptureWriter::create(file.path(), capture::Flushing::inBlocks);
    require(writer.ok(), "a file in memory cannot be created");
    for (const MetricEvent& event : events) require(!writer->write(event), "an event cannot be written");
  }
  auto reader = capture::CaptureReader::open(file.path());
  require(reader.ok(), "a capture of ours cannot be read");
  std::vector<MetricEvent> replayed;
  for (auto event = reader->next(); event.ok() && *event; event = reader->next()) replayed.push_back(**event);
  require(replayed.size() == events.size(), "a capture of ours cannot be read whole");
  require(stateAfter(replayed) == direct, "replayed events leave another state");
  return 0;
}
