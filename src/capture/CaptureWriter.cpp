#include "capture/CaptureWriter.h"

#include <fcntl.h>
#include <sys/stat.h>

#include <utility>

#include "capture/EventPacket.h"

namespace vespscope::capture {

Result<CaptureWriter> CaptureWriter::create(const std::string& path, Flushing flushing, Existing existing) {
  const std::string name = path == "-" ? "standard output" : path;
  auto output = PcapOutput::create(path, existing);
  if (!output) return Failure{name + ": " + output.reason()};
  return CaptureWriter(name, flushing, std::move(*output));
}

Result<CaptureWriter> CaptureWriter::createWhole(const std::string& path, Flushing flushing, Existing existing) {
  struct stat found {};
  const bool present = path != "-" && ::stat(path.c_str(), &found) == 0;
  if (path == "-" || (present && !S_ISREG(found.st_mode) && !S_ISDIR(found.st_mode))) {
    return create(path, flushing, Existing::replace);
  }
  auto file = files::NewFile::create(
      path, existing == Existing::refuse ? files::NewFile::Existing::refuse : files::NewFile::Existing::replace);
  if (!file) return Failure{file.reason()};
  auto output = PcapOutput::into(::fcntl(file->descriptor(), F_DUPFD_CLOEXEC, 0));
  if (!output) {
    file->discard();
    return Failure{path + ": " + output.reason()};
  }
  CaptureWriter writer(path, flushing, std::move(*output));
  writer.partial_.emplace(std::move(*file));
  return writer;
}

std::optional<std::string> CaptureWriter::finish() {
  if (auto reason = flush()) return reason;
  if (!partial_) return std::nullopt;
  if (auto reason = partial_->finish()) return reason;
  partial_.reset();
  return std::nullopt;
}

std::string CaptureWriter::leavePartial() {
  if (!partial_) return {};
  static_cast<void>(output_.flush());
  if (count() != 0) return "; " + std::to_string(count()) + " events are in " + partial_->partialName();
  partial_->discard();
  return {};
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
