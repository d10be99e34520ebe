#include "support/ScriptedRun.h"

#include <chrono>

#include "support/ScriptedMessages.h"

namespace vespscope::test {

std::vector<MetricEvent> scriptedRun() {
  std::vector<MetricEvent> events;
  for (const auto& messages : {lteMessages(), mobilityMessages(), umtsMessages(), gsmMessages()}) {
    for (const ScriptedMessage& message : messages) {
      const std::uint64_t time = scriptedRunStart + 1000 * events.size();
      events.push_back({message.metricID, 0, message.encode(time), std::chrono::milliseconds(time)});
    }
  }
  return events;
}

Record eventDictionary(const MetricEvent& event) {
  return {{"kKeyMetricID", std::int64_t{event.metricID}},
          {"kKeyPayload", event.payload},
          {"kKeyProfileID", std::int64_t{event.profileID}}};
}

}  // namespace vespscope::test
