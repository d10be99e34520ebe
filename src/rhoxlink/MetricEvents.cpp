#include "rhoxlink/MetricEvents.h"

#include <cstdint>
#include <string_view>
#include <utility>

#include "rhoxlink/bus/Names.h"

namespace rhox::client {
namespace {

using vespscope::ipc::Dictionary;
using vespscope::ipc::Object;

// Returns the entry's value if it is a 32-bit number.
std::optional<std::int32_t> numberIn(const Dictionary& event, std::string_view key) {
  const Object* object = event.find(key);
  const std::int64_t* number = object == nullptr ? nullptr : object->asInt64();
  if (number == nullptr || !std::in_range<std::int32_t>(*number)) return std::nullopt;
  return static_cast<std::int32_t>(*number);
}

}  // namespace

std::optional<vespscope::MetricEvent> metricEventOf(const Object& event, std::chrono::nanoseconds time) {
  const Dictionary* dictionary = event.asDictionary();
  if (dictionary == nullptr) return std::nullopt;
  const std::optional<std::int32_t> metric = numberIn(*dictionary, kKeyMetricID);
  const Object* payload = dictionary->find(kKeyPayload);
  if (!metric || payload == nullptr || payload->asData() == nullptr) return std::nullopt;
  std::int32_t profile = 0;
  if (dictionary->find(kKeyProfileID) != nullptr) {
    const std::optional<std::int32_t> given = numberIn(*dictionary, kKeyProfileID);
    if (!given) return std::nullopt;
    profile = *given;
  }
  return vespscope::MetricEvent{*metric, profile, *payload->asData(), time};
}

}  // namespace rhox::client
