#include "sources/replay/ReplayStream.h"

#include <filesystem>
#include <system_error>
#include <utility>

#include "platform/files/InputFile.h"
#include "platform/log/Log.h"
#include "registry/MetricRows.h"
#include "sources/playback/RecordedTime.h"

namespace vespscope::sources {
namespace {

constexpr std::size_t namedFailures = 16;
constexpr std::int32_t simCardFilesMetric = metricIdentifier("K_SIM_FILE_INFO");

bool canBeReadAgain(const std::string& path) {
  std::error_code error;
  return std::filesystem::is_regular_file(path, error) || std::filesystem::is_directory(path, error);
}

// A pipe's header may not have been written yet.
bool isPipe(const std::string& path) {
  std::error_code error;
  if (path != "-" && std::filesystem::is_directory(path, error)) return false;
  const auto file = files::InputFile::open(path);
  return file && !(*file)->canRewind();
}

// "drive.pcap" for "recordings/drive.pcap", "recordings" for "recordings/".
std::string nameOf(const std::string& path) {
  if (path == "-") return capture::nameOfInput(path);
  const std::filesystem::path whole = std::filesystem::path(path).lexically_normal();
  const std::string name = (whole.has_filename() ? whole : whole.parent_path()).filename().string();
  return name.empty() || name == "." || name == ".." ? path : name;
}

std::optional<MetricEvent> lastSimCardFiles(const std::string& path, const std::stop_token& stop) {
  auto reader = capture::CaptureReader::open(path);
  if (!reader) return std::nullopt;
  std::optional<MetricEvent> last;
  while (!stop.stop_requested()) {
    auto event = reader->next();
    if (!event) continue;  // the next file of the folder, or the end
    if (!event->has_value()) return last;
    if ((*event)->metricID == simCardFilesMetric) last = std::move(**event);
  }
  return std::nullopt;
}

}  // namespace

Result<std::unique_ptr<ReplayStream>> ReplayStream::open(const std::string& path) {
  auto interruption = std::make_shared<const dispatch::WakeDescriptor>();
  if (isPipe(path)) {
    return std::unique_ptr<ReplayStream>(new ReplayStream(path, nameOf(path), std::nullopt, std::move(interruption)));
  }
  auto reader = capture::CaptureReader::open(path, interruption);
  if (!reader) return Failure{reader.reason()};
  return std::unique_ptr<ReplayStream>(
      new ReplayStream(path, nameOf(path), std::move(*reader), std::move(interruption)));
}

ReplayStream::ReplayStream(std::string path, std::string label, std::optional<capture::CaptureReader> reader,
                           std::shared_ptr<const dispatch::WakeDescriptor> interruption)
    : path_(std::move(path)),
      label_(std::move(label)),
      canRewind_(canBeReadAgain(path_)),
      reader_(std::move(reader)),
      opened_(reader_.has_value()),
      interruption_(std::move(interruption)),
      bytesInAll_(reader_ ? reader_->bytesInAll() : 0) {}

std::optional<MetricEvent> ReplayStream::next() {
  if (!opened_) openReader();
  if (!reader_) return std::nullopt;
  auto event = reader_->next();
  for (; !event; event = reader_->next()) note(event.reason());
  if (!canRewind() && event->has_value() && (*event)->metricID == simCardFilesMetric) {
    const std::lock_guard lock(simMutex_);
    sim_ = **event;
  }
  return std::move(*event);
}

void ReplayStream::rewind() {
  if (!canRewind()) log::fatal("a capture that comes through a pipe cannot be rewound");
  failures_.clear();
  failureCount_ = 0;
  openReader();
}

void ReplayStream::openReader() {
  opened_ = true;
  reader_.reset();
  auto reader = capture::CaptureReader::open(path_, interruption_);
  if (reader) {
    reader_ = std::move(*reader);
  } else {
    note(reader.reason());
  }
}

void ReplayStream::note(const std::string& failure) {
  if (++failureCount_ > namedFailures) return;
  if (!failures_.empty()) failures_ += "; ";
  failures_ += failure;
}

std::optional<std::string> ReplayStream::failure() const {
  if (failureCount_ == 0) return std::nullopt;
  if (failureCount_ <= namedFailures) return failures_;
  return failures_ + "; and " + std::to_string(failureCount_ - namedFailures) + " more files";
}

InputProgress ReplayStream::progress() const { return {reader_ ? reader_->bytesRead() : 0, bytesInAll_}; }

std::string ReplayStream::summary() const { return std::to_string(reader_ ? reader_->count() : 0) + " events"; }

std::optional<MetricEvent> ReplayStream::simCardFiles(std::stop_token stop) {
  const std::lock_guard lock(simMutex_);
  if (canRewind() && !simSearched_) {
    sim_ = lastSimCardFiles(path_, stop);
    simSearched_ = !stop.stop_requested();
  }
  return sim_;
}

std::optional<std::chrono::nanoseconds> ReplayStream::length(const std::stop_token& stop) {
  if (!canRewind()) return std::nullopt;
  const Result<std::unique_ptr<ReplayStream>> again = open(path_);
  if (!again) return std::nullopt;
  const std::stop_callback end(stop, [&again] { (*again)->interrupt(); });
  return lengthOf(**again, stop);
}

Result<std::unique_ptr<EventStream>> openReplayStream(const std::string& path) {
  auto stream = ReplayStream::open(path);
  if (!stream) return Failure{stream.reason()};
  return std::unique_ptr<EventStream>(std::move(*stream));
}

}  // namespace vespscope::sources
