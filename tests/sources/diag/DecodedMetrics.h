// Metric events by their meaning: the class by its identifier, the fields by their names.
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

inline std::string classNameOf(std::int32_t metricID) {
  for (const MetricRow& row : metricRows) {
    if (row.identifier() != metricID) continue;
    // The registry spells one class without its technology, and some with a small letter.
    if (row.tag == 0x4F6A) return "KCellularLteRsrpRsrqSinr";
    return "K" + std::string(row.registryText).substr(1);
  }
  return {};
}

// The event's fields; the test fails if the payload is not a message of the metric's class.
inline Record recordOf(const MetricEvent& event) {
  for (const MessageClass& candidate : messageClasses()) {
    if (candidate.name != classNameOf(event.metricID)) continue;
    const auto message = candidate.make();
    WireReader reader(event.payload);
    EXPECT_TRUE(message->readFrom(reader)) << candidate.name;
    // A field numbered like a metric's tag is never stored.
    const bool losesField =
        candidate.name == "KCellularGsmIdleConfig" || candidate.name == "KCellularLteSelReselCellInfo";
    EXPECT_TRUE(losesField || message->encoded() == event.payload) << candidate.name;
    return message->dictionaryRepresentation();
  }
  ADD_FAILURE() << "no class for metric " << event.metricID;
  return {};
}

// "KCellularLteRrcState[state: …]" for each event.
inline std::vector<std::string> textsOf(const std::vector<MetricEvent>& events) {
  std::vector<std::string> texts;
  for (const MetricEvent& event : events) {
    texts.push_back(classNameOf(event.metricID) + toText(recordOf(event)));
  }
  return texts;
}

}  // namespace vespscope::test
