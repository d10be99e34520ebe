#include <cinttypes>
#include <cstdio>

#include <nlohmann/json.hpp>

#include "capture/CaptureReader.h"
#include "metrics/EventRows.h"
#include "tools/vespctl/Commands.h"
#include "tools/vespctl/Json.h"
#include "tools/vespctl/Output.h"

namespace vespscope::tools {
namespace {

// Seconds since 1970 with nine decimals.
std::string timeText(std::chrono::nanoseconds time) {
  const auto seconds = std::chrono::floor<std::chrono::seconds>(time);
  std::array<char, 40> text;
  const int length = std::snprintf(text.data(), text.size(), "%" PRId64 ".%09" PRId64, std::int64_t{seconds.count()},
                                   std::int64_t{(time - seconds).count()});
  return {text.data(), static_cast<std::size_t>(length)};
}

Json packetJson(std::uint64_t index, const MetricEvent& event) {
  Json packet = {{"index", index},
                 {"time", timeText(event.time)},
                 {"metric_id", event.metricID},
                 {"profile_id", event.profileID},
                 {"message", nullptr},
                 {"ok", nullptr},
                 {"record", nullptr}};
  if (const EventRow* row = findEventRow(event.metricID)) {
    const DecodedPayload decoded = row->decode(&event.payload);
    packet["message"] = row->message;
    packet["ok"] = decoded.ok;
    packet["record"] = toJson(decoded.record);
  }
  return packet;
}

}  // namespace

Problem decode(const std::string& file) {
  Result<capture::CaptureReader> reader = capture::CaptureReader::open(file);
  if (!reader) return reader.reason();
  for (;;) {
    const std::uint64_t index = reader->count();
    const Result<std::optional<MetricEvent>> event = reader->next();
    if (!event) return event.reason();
    if (!*event) return std::nullopt;
    if (Problem problem = writeLine(write(packetJson(index, **event)))) return problem;
  }
}

}  // namespace vespscope::tools
