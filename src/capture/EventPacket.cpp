#include "capture/EventPacket.h"

#include <limits>
#include <optional>
#include <string>

#include "messages/WireReader.h"
#include "messages/WireWriter.h"

namespace vespscope::capture {
namespace {

constexpr std::uint32_t metricIdField = 1;
constexpr std::uint32_t profileIdField = 2;
constexpr std::uint32_t payloadField = 3;

std::string noEvent(std::string_view why) { return "not a MetricEvent: " + std::string(why); }

}  // namespace

Bytes packetOf(const MetricEvent& event) {
  WireWriter writer;
  writer.writeUint32(static_cast<std::uint32_t>(event.metricID), metricIdField);
  writer.writeInt32(event.profileID, profileIdField);
  writer.writeBytes(event.payload, payloadField);
  return writer.takeBytes();
}

Result<MetricEvent> eventOf(std::span<const std::uint8_t> packet, std::chrono::nanoseconds time) {
  MetricEvent event;
  event.time = time;
  std::optional<std::uint64_t> metricID;
  WireReader reader(packet);
  while (reader.hasMore()) {
    const std::uint64_t rawKey = reader.readVarint();
    const std::uint64_t field = rawKey >> 3;
    const WireKey key(rawKey);
    if (reader.failed() || field == 0) return Failure{noEvent("a field without a valid number")};
    const bool known = field <= payloadField;
    const WireType expected = field == payloadField ? WireType::lengthDelimited : WireType::varint;
    if (known && key.wireType != expected) {
      return Failure{noEvent("field " + std::to_string(field) + " has the wrong wire type")};
    }
    if (field == metricIdField) {
      metricID = reader.readVarint();
    } else if (field == profileIdField) {
      event.profileID = static_cast<std::int32_t>(reader.readVarint());
    } else if (field == payloadField) {
      if (const auto payload = reader.readDelimited()) event.payload.assign(payload->begin(), payload->end());
    } else if (!reader.skip(key)) {
      return Failure{noEvent("field " + std::to_string(field) + " cannot be skipped")};
    }
    if (reader.failed()) return Failure{noEvent("field " + std::to_string(field) + " reaches past the end")};
  }
  if (!metricID) return Failure{std::string("a MetricEvent without metric_id")};
  if (*metricID > static_cast<std::uint64_t>(std::numeric_limits<std::int32_t>::max())) {
    return Failure{"metric_id " + std::to_string(*metricID) + " is out of range"};
  }
  event.metricID = static_cast<std::int32_t>(*metricID);
  return event;
}

}  // namespace vespscope::capture
