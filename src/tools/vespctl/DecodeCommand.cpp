#include <array>
#include <charconv>
#include <chrono>
#include <string>

#include "metrics/EventRows.h"
#include "tools/vespctl/Commands.h"
#include "tools/vespctl/Input.h"
#include "tools/vespctl/Json.h"
#include "tools/vespctl/Output.h"

namespace vespscope::tools {
namespace {

void appendNumber(std::string& out, std::int64_t number) {
  std::array<char, 24> digits;
  out.append(digits.data(), std::to_chars(digits.data(), digits.data() + digits.size(), number).ptr);
}

// Seconds since 1970 with nine decimals.
void appendTime(std::string& out, std::chrono::nanoseconds time) {
  const auto seconds = std::chrono::floor<std::chrono::seconds>(time);
  constexpr std::int64_t nineDigits = 1'000'000'000;
  appendNumber(out, seconds.count());
  // The leading digit preserves the zeros after it; the point replaces it.
  const std::size_t point = out.size();
  appendNumber(out, nineDigits + (time - seconds).count());
  out[point] = '.';
}

// Appends one JSON object on one line.
void appendPacket(std::string& out, std::uint64_t index, const MetricEvent& event) {
  out += "{\"index\":";
  appendNumber(out, static_cast<std::int64_t>(index));
  out += ",\"time\":\"";
  appendTime(out, event.time);
  out += "\",\"metric_id\":";
  appendNumber(out, event.metricID);
  out += ",\"profile_id\":";
  appendNumber(out, event.profileID);
  if (const EventRow* row = findEventRow(event.metricID)) {
    const DecodedPayload decoded = row->decode(&event.payload);
    out += ",\"message\":\"";
    out += row->message;
    out += decoded.ok ? "\",\"ok\":true,\"record\":" : "\",\"ok\":false,\"record\":";
    appendJson(out, decoded.record);
    out += '}';
  } else {
    out += R"(,"message":null,"ok":null,"record":null})";
  }
}

}  // namespace

Problem decode(const std::string& file, Sim sim) {
  Result<Input> input = Input::open(file);
  if (!input) return input.reason();
  input->choose(sim);
  std::string line;
  while (true) {
    const std::optional<MetricEvent> event = input->next();
    if (!event) return input->problem();
    const std::uint64_t index = input->count() - 1;
    line.clear();
    appendPacket(line, index, *event);
    if (Problem problem = writeLine(line)) return problem;
  }
}

}  // namespace vespscope::tools
