// Metric events as what they mean: the class by its identifier, the fields by their names.
#pragma once

#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>

#include "messages/MessageClasses.h"
#include "messages/WireReader.h"
#include "registry/MetricRows.h"
#include "values/MetricEvent.h"
#include "values/Text.h"

namespace vespscope::test {

inline std::string_view classNameOf(std::int32_t metricID) {
  for (const MetricRow& row : metricRows) {
    // The registry spells one class without its technology.
    if (row.identifier() == metricID) return row.tag == 0x4F6A ? "KCellularLteRsrpRsrqSinr" : row.registryText;
  }
  return {};
}

// The event's fields; a failure of the test when the payload is no message of the metric's class.
inline Record recordOf(const MetricEvent& event) {
  for (const MessageClass& candidate : messageClasses()) {
    if (candidate.name != classNameOf(event.metricID)) continue;
    const auto message = candidate.make();
    WireReader reader(event.payload);
    EXPECT_TRUE(message->readFrom(reader)) << candidate.name;
    EXPECT_EQ(message->encoded(), event.payload) << candidate.name;
    return message->dictionaryRepresentation();
  }
  ADD_FAILURE() << "no class for metric " << event.metricID;
  return {};
}

// "KCellularLteRrcState[state: …]" for each event.
inline std::vector<std::string> textsOf(const std::vector<MetricEvent>& events) {
  std::vector<std::string> texts;
  for (const MetricEvent& event : events) {
    texts.push_back(std::string(classNameOf(event.metricID)) + toText(recordOf(event)));
  }
  return texts;
}

}  // namespace vespscope::test
