#include "capture/CaptureWriter.h"

#include "capture/EventPacket.h"

namespace vespscope::capture {

Result<CaptureWriter> CaptureWriter::create(const std::string& path, Flushing flushing, Existing existing) {
  const std::string name = path == "-" ? "standard output" : path;
  auto output = PcapOutput::create(path, existing);
  if (!output) return Failure{name + ": " + output.reason()};
  return CaptureWriter(name, flushing, std::move(*output));
}

std::optional<std::string> CaptureWriter::write(const MetricEvent& event) {
  const Bytes packet = packetOf(event);
  std::optional<std::string> reason = output_.write({packet, event.time});
  if (!reason && flushing_ == Flushing::eachPacket) reason = output_.flush();
  if (reason) return name_ + ": packet " + std::to_string(count()) + ": " + *reason;
  return std::nullopt;
}

std::optional<std::string> CaptureWriter::flush() {
  if (const auto reason = output_.flush()) return name_ + ": " + *reason;
  return std::nullopt;
}

}  // namespace vespscope::capture
