#include "capture/CaptureReader.h"

#include "capture/EventPacket.h"

namespace vespscope::capture {

std::string nameOfInput(const std::string& path) { return path == "-" ? "standard input" : path; }

Result<CaptureReader> CaptureReader::open(const std::string& path) {
  auto input = PcapInput::open(path);
  if (!input) return Failure{nameOfInput(path) + ": " + input.reason()};
  return CaptureReader(nameOfInput(path), std::move(*input));
}

Result<std::optional<MetricEvent>> CaptureReader::next() {
  if (failure_) return Failure{*failure_};
  const auto packet = input_.next();
  if (!packet) return fail(packet.reason());
  if (!packet->has_value()) return std::optional<MetricEvent>{};
  auto event = eventOf((*packet)->bytes, (*packet)->time);
  if (!event) return fail(event.reason());
  ++count_;
  return std::optional<MetricEvent>(std::move(*event));
}

Result<std::optional<MetricEvent>> CaptureReader::fail(const std::string& reason) {
  failure_ = name_ + ": packet " + std::to_string(count_) + ": " + reason;
  return Failure{*failure_};
}

}  // namespace vespscope::capture
