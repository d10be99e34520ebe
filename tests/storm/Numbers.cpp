#include "storm/Numbers.h"

#include <charconv>
#include <chrono>
#include <stdexcept>

#include "capture/CaptureReader.h"
#include "capture/CaptureWriter.h"
#include "registry/MetricRows.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;

constexpr std::string_view field = "prev_state_dur_ms: ";
constexpr std::uint8_t stateKey = 0x10;     // of KCellularLteRrcState, as a varint
constexpr std::uint8_t durationKey = 0x20;  // likewise

void appendVarint(Bytes& bytes, std::uint64_t value) {
  for (; value >= 0x80; value >>= 7) bytes.push_back(static_cast<std::uint8_t>(value | 0x80));
  bytes.push_back(static_cast<std::uint8_t>(value));
}

std::optional<std::uint64_t> numberOf(const Bytes& payload) {
  if (payload.size() < 4 || payload[0] != stateKey || payload[2] != durationKey) return std::nullopt;
  std::uint64_t value = 0;
  for (std::size_t index = 3; index < payload.size(); ++index) {
    value |= static_cast<std::uint64_t>(payload[index] & 0x7F) << 7 * (index - 3);
  }
  return value;
}

}  // namespace

void writeSource(const std::string& path, Life life, std::uint32_t count, std::uint32_t rate) {
  constexpr std::chrono::nanoseconds begin = 1'700'000'000s;
  auto writer = capture::CaptureWriter::create(path, capture::Flushing::inBlocks);
  if (!writer) throw std::runtime_error(writer.reason());
  MetricEvent event;
  event.metricID = metricIdentifier("K_LTE_RRC_STATE");
  for (std::uint32_t number = 0; number < count; ++number) {
    event.time = begin + std::chrono::nanoseconds(1s) * number / rate;
    event.payload = {stateKey, 1, durationKey};
    appendVarint(event.payload, std::uint64_t{life} * mostEvents + number);
    if (auto problem = writer->write(event)) throw std::runtime_error(*problem);
  }
  if (auto problem = writer->finish()) throw std::runtime_error(*problem);
}

void Numbers::take(std::uint64_t value) {
  const auto number = static_cast<std::uint32_t>(value % mostEvents);
  const auto [place, isFirst] = lives_.try_emplace(static_cast<Life>(value / mostEvents));
  Arrivals& arrivals = place->second;
  ++count_;
  ++arrivals.count;
  if (isFirst) {
    arrivals.first = number;
  } else if (number <= arrivals.last) {
    ++(number == arrivals.last ? arrivals.again : arrivals.misplaced);
    return;
  } else {
    arrivals.missing += number - arrivals.last - 1;
  }
  arrivals.last = number;
}

void Numbers::readLines(std::string_view text) {
  rest_ += text;
  const std::size_t end = rest_.rfind('\n') + 1;  // 0 when no line has ended
  const std::string_view lines(rest_.data(), end);
  for (std::size_t place = lines.find(field); place != std::string_view::npos; place = lines.find(field, place + 1)) {
    std::uint64_t value = 0;
    const char* digits = lines.data() + place + field.size();
    std::from_chars(digits, lines.data() + lines.size(), value);
    take(value);
  }
  rest_.erase(0, end);
}

std::optional<std::string> Numbers::readCapture(const std::string& path) {
  auto reader = capture::CaptureReader::open(path);
  if (!reader) return reader.reason();
  std::optional<std::string> problem;
  while (true) {
    auto event = reader->next();
    if (!event) {
      // Of a folder, the next file is read.
      problem = event.reason();
      continue;
    }
    if (!*event) return problem;
    if (const auto value = numberOf((*event)->payload)) take(*value);
  }
}

Arrivals Numbers::of(Life life) const {
  const auto place = lives_.find(life);
  return place == lives_.end() ? Arrivals{} : place->second;
}

}  // namespace vespscope::test
