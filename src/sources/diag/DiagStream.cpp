#include "sources/diag/DiagStream.h"

#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <filesystem>
#include <utility>

#include "platform/log/Log.h"
#include "sources/playback/RecordedTime.h"

namespace vespscope::sources {
namespace diag {
namespace {

constexpr std::size_t pieceLength = 65'536;
// A log begins with a good frame within this; a recording may begin in the middle of one.
constexpr std::uint64_t searchLength = 1U << 20;

// "-" is standard input, which stays open when the stream is closed.
std::FILE* openFile(const std::string& path) {
  if (path != "-") return std::fopen(path.c_str(), "rb");
  const int copy = ::dup(STDIN_FILENO);
  return copy < 0 ? nullptr : ::fdopen(copy, "rb");
}

std::string nameOf(const std::string& path) { return path == "-" ? "standard input" : path; }

}  // namespace

Result<std::unique_ptr<DiagStream>> DiagStream::open(const std::string& path) {
  const std::string name = nameOf(path);
  std::unique_ptr<std::FILE, FileCloser> file(openFile(path));
  if (!file) return Failure{name + ": cannot be opened: " + std::strerror(errno)};
  const std::string label = path == "-" ? name : std::filesystem::path(path).filename().string();
  std::unique_ptr<DiagStream> stream(new DiagStream(path, label, std::move(file)));
  const bool begins = stream->beginsLikeALog();
  if (stream->failure_) return Failure{*stream->failure_};
  if (!begins) return Failure{name + ": not a modem log: no frame with a right checksum in its first MiB"};
  return stream;
}

DiagStream::DiagStream(std::string path, std::string label, std::unique_ptr<std::FILE, FileCloser> file)
    : path_(std::move(path)),
      name_(nameOf(path_)),
      label_(std::move(label)),
      file_(std::move(file)),
      canRewind_(std::fseek(file_.get(), 0, SEEK_SET) == 0),
      piece_(pieceLength) {}

std::optional<MetricEvent> DiagStream::next() {
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
  if (!canRewind_) log::fatal("a modem log that comes through a pipe cannot be rewound");
  bytesRead_ = 0;
  frames_ = {};
  firstFrame_.reset();
  mapper_ = {};
  events_.clear();
  failure_.reset();
  if (std::fseek(file_.get(), 0, SEEK_SET) != 0) failure_ = name_ + ": cannot be read again: " + std::strerror(errno);
}

std::optional<std::chrono::nanoseconds> DiagStream::length(std::stop_token stop) {
  // Standard input would be read from the same offset that playing reads from.
  if (!canRewind_ || path_ == "-") return std::nullopt;
  const Result<std::unique_ptr<DiagStream>> again = open(path_);
  return again ? lengthOf(**again, stop) : std::nullopt;
}

DiagReport DiagStream::counts() const {
  DiagReport report = mapper_.report();
  report.frames = frames_.counters();
  return report;
}

bool DiagStream::beginsLikeALog() {
  while (!firstFrame_) {
    firstFrame_ = frames_.next();
    if (!firstFrame_ && (bytesRead_ >= searchLength || !readPiece())) return false;
  }
  return true;
}

std::optional<std::span<const std::uint8_t>> DiagStream::nextFrame() {
  if (firstFrame_) return std::exchange(firstFrame_, std::nullopt);
  while (true) {
    if (const auto frame = frames_.next()) return frame;
    if (!readPiece()) return std::nullopt;
  }
}

bool DiagStream::readPiece() {
  const std::size_t count = std::fread(piece_.data(), 1, piece_.size(), file_.get());
  if (count == 0) {
    if (std::ferror(file_.get()) != 0) failure_ = name_ + ": cannot be read: " + std::strerror(errno);
    frames_.finish();
    return false;
  }
  bytesRead_ += count;
  frames_.feed({piece_.data(), count});
  return true;
}

}  // namespace diag

Result<std::unique_ptr<EventStream>> openDiagStream(const std::string& path) {
  auto stream = diag::DiagStream::open(path);
  if (!stream) return Failure{stream.reason()};
  return std::unique_ptr<EventStream>(std::move(*stream));
}

}  // namespace vespscope::sources
