#include "sources/diag/DiagStream.h"

#include <algorithm>
#include <filesystem>
#include <string_view>
#include <utility>

#include "platform/files/FormatHint.h"
#include "platform/log/Log.h"
#include "sources/playback/RecordedTime.h"

namespace vespscope::sources {
namespace diag {
namespace {

constexpr std::size_t pieceLength = 65'536;
// A log begins with a valid frame within this length; a recording may begin in the middle of one.
constexpr std::uint64_t searchLength = 1U << 20;

std::string nameOf(const std::string& path) { return path == "-" ? "standard input" : path; }

std::string whyNoLog(std::span<const std::uint8_t> head) {
  const std::string_view hint = files::formatHint(head);
  return hint.empty() ? "no frame with a valid checksum in its first MiB" : std::string(hint);
}

}  // namespace

Result<std::unique_ptr<DiagStream>> DiagStream::open(const std::string& path) {
  const std::string name = nameOf(path);
  auto interruption = std::make_shared<const dispatch::WakeDescriptor>();
  auto file = files::UnpackedFile::open(path, interruption);
  if (!file) return Failure{name + ": " + file.reason()};
  const std::string label = path == "-" ? name : std::filesystem::path(path).filename().string();
  std::unique_ptr<DiagStream> stream(new DiagStream(path, label, std::move(*file), std::move(interruption)));
  // A pipe may have no data for a long time: the first next() examines it.
  if (stream->canRewind()) stream->examine();
  if (stream->failure_) return Failure{*stream->failure_};
  return stream;
}

DiagStream::DiagStream(std::string path, std::string label, std::unique_ptr<files::UnpackedFile> file,
                       std::shared_ptr<const dispatch::WakeDescriptor> interruption)
    : path_(std::move(path)),
      name_(nameOf(path_)),
      label_(std::move(label)),
      interruption_(std::move(interruption)),
      file_(std::move(file)),
      piece_(pieceLength) {}

std::optional<MetricEvent> DiagStream::next() {
  if (!examined_) examine();
  if (failure_) return std::nullopt;
  while (events_.empty()) {
    const auto frame = nextFrame();
    if (!frame) return std::nullopt;
    mapper_.take(*frame, events_);
  }
  MetricEvent event = std::move(events_.front());
  events_.pop_front();
  return event;
}

void DiagStream::rewind() {
  if (!canRewind()) log::fatal("a modem log that comes through a pipe cannot be rewound");
  frames_ = {};
  firstFrame_.reset();
  mapper_ = {};
  events_.clear();
  failure_.reset();
  if (const auto reason = file_->rewind()) failure_ = name_ + ": " + *reason;
}

std::optional<std::chrono::nanoseconds> DiagStream::length(const std::stop_token& stop) {
  // A second reader of standard input would share the offset with playing.
  if (!canRewind() || path_ == "-") return std::nullopt;
  const Result<std::unique_ptr<DiagStream>> again = open(path_);
  if (!again) return std::nullopt;
  // There may be a long stretch without events.
  const std::stop_callback end(stop, [&again] { (*again)->interrupt(); });
  return lengthOf(**again, stop);
}

DiagReport DiagStream::counts() const {
  DiagReport report = mapper_.report();
  report.frames = frames_.counters();
  return report;
}

void DiagStream::examine() {
  examined_ = true;
  while (!firstFrame_) {
    firstFrame_ = frames_.next();
    if (firstFrame_) return;
    if (file_->unpacked() < searchLength && readPiece()) continue;
    if (failure_ || file_->interrupted()) return;
    failure_ = name_ + (file_->unpacked() == 0 ? ": is empty" : ": not a modem log: " + whyNoLog(head_));
    return;
  }
}

std::optional<std::span<const std::uint8_t>> DiagStream::nextFrame() {
  if (firstFrame_) return std::exchange(firstFrame_, std::nullopt);
  while (true) {
    if (const auto frame = frames_.next()) return frame;
    if (!readPiece()) return std::nullopt;
  }
}

bool DiagStream::readPiece() {
  const Result<std::size_t> count = file_->read(piece_);
  if (!count) failure_ = name_ + ": " + count.reason();
  if (!count || *count == 0) {
    frames_.finish();
    return false;
  }
  if (head_.empty())
    head_.assign(piece_.begin(),
                 piece_.begin() + static_cast<std::ptrdiff_t>(std::min(*count, files::formatHintLength)));
  frames_.feed({piece_.data(), *count});
  return true;
}

}  // namespace diag

Result<std::unique_ptr<EventStream>> openDiagStream(const std::string& path) {
  auto stream = diag::DiagStream::open(path);
  if (!stream) return Failure{stream.reason()};
  return std::unique_ptr<EventStream>(std::move(*stream));
}

}  // namespace vespscope::sources
