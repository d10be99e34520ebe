// The messages of the scripted run, one list per technology.
#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <utility>
#include <vector>

#include "messages/WireMessage.h"
#include "registry/MetricRows.h"

namespace vespscope::test {

struct ScriptedMessage {
  std::int32_t metricID;
  // Makes the message whose "timestamp" is this number of milliseconds since 1970.
  std::function<Bytes(std::uint64_t timestamp)> encode;
};

// A metric with the message that `fill` fills.
template <class Message, class Fill>
ScriptedMessage scripted(std::int32_t metricID, Fill fill) {
  return {metricID, [fill](std::uint64_t timestamp) {
            Message message;
            message.setTimestamp(timestamp);
            fill(message);
            return message.encoded();
          }};
}

// An embedded message that `fill` fills.
template <class Element, class Fill>
std::shared_ptr<Element> part(Fill fill) {
  auto element = std::make_shared<Element>();
  fill(*element);
  return element;
}

std::vector<ScriptedMessage> lteMessages();
std::vector<ScriptedMessage> mobilityMessages();
std::vector<ScriptedMessage> umtsMessages();
std::vector<ScriptedMessage> gsmMessages();

}  // namespace vespscope::test
