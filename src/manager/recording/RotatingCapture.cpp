#include "manager/recording/RotatingCapture.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <string_view>
#include <system_error>
#include <utility>

#include "platform/log/Log.h"

namespace vespscope::manager {
namespace {

constexpr mode_t ownerOnly = 0700;
constexpr std::string_view unfinished = capture::PcapOutput::unfinished;
constexpr std::uint64_t packetOverhead = 64;  // bytes of a packet beside its payload, at most

std::string reasonOf(int error) { return std::strerror(error); }

std::chrono::system_clock::time_point timeOf(const timespec& time) {
  return std::chrono::system_clock::time_point(
      std::chrono::duration_cast<std::chrono::system_clock::duration>(std::chrono::seconds(time.tv_sec)));
}

}  // namespace

Result<std::unique_ptr<RotatingCapture>> RotatingCapture::open(std::filesystem::path folder,
                                                               const RecordingLimits& limits, RecordingClock clock) {
  std::unique_ptr<RotatingCapture> capture(new RotatingCapture(std::move(folder), limits, std::move(clock)));
  if (Problem problem = capture->holdFolder()) return Failure{*std::move(problem)};
  return capture;
}

RotatingCapture::~RotatingCapture() {
  if (held_ >= 0) ::close(held_);
}

bool RotatingCapture::holdsFolder() const {
  struct stat held {};
  struct stat found {};
  return held_ >= 0 && ::fstat(held_, &held) == 0 && ::stat(folder_.c_str(), &found) == 0 &&
         held.st_dev == found.st_dev && held.st_ino == found.st_ino;
}

RotatingCapture::Problem RotatingCapture::holdFolder() {
  if (holdsFolder()) return std::nullopt;
  if (held_ >= 0) ::close(std::exchange(held_, -1));
  std::error_code error;
  if (folder_.has_parent_path()) std::filesystem::create_directories(folder_.parent_path(), error);
  ::mkdir(folder_.c_str(), ownerOnly);  // one that is there, or cannot be made, shows in what follows
  const int folder = ::open(folder_.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
  if (folder < 0) return folder_.string() + ": cannot be recorded into: " + reasonOf(errno);
  if (::flock(folder, LOCK_EX | LOCK_NB) != 0) {
    const int reason = errno;
    ::close(folder);
    return folder_.string() + (reason == EWOULDBLOCK ? ": another program is recording into it"
                                                     : ": cannot be recorded into: " + reasonOf(reason));
  }
  held_ = folder;
  if (::access(folder_.c_str(), W_OK | X_OK) != 0) {
    return folder_.string() + ": cannot be recorded into: " + reasonOf(errno);
  }
  repairLast();
  return std::nullopt;
}

// The recordings in the folder, the oldest first. What a killed run was only about to begin is removed.
std::vector<RotatingCapture::File> RotatingCapture::files() const {
  std::vector<File> found;
  std::error_code error;
  for (std::filesystem::directory_iterator entry(folder_, error), end; !error && entry != end; entry.increment(error)) {
    const std::string name = entry->path().filename().string();
    struct stat file {};
    if (name.ends_with(unfinished) && recordingTime(name.substr(0, name.size() - unfinished.size()))) {
      ::unlink(entry->path().c_str());
    }
    if (!recordingTime(name) || ::lstat(entry->path().c_str(), &file) != 0) continue;
    const bool own = S_ISREG(file.st_mode) && file.st_uid == ::geteuid();
    found.push_back({name, static_cast<std::uint64_t>(file.st_size), timeOf(file.st_mtim), own});
  }
  std::sort(found.begin(), found.end(), [](const File& one, const File& other) { return one.name < other.name; });
  return found;
}

void RotatingCapture::repairLast() const {
  const std::vector<File> present = files();
  const auto last = std::find_if(present.rbegin(), present.rend(), [](const File& file) { return file.own; });
  if (last == present.rend()) return;
  const std::filesystem::path path = folder_ / last->name;
  const Result<std::uint64_t> whole = capture::cutToWholePackets(path);
  if (!whole) {
    log::system(path.string() + ": " + whole.reason());
  } else if (*whole == 0) {
    ::unlink(path.c_str());
  } else if (*whole < last->size) {
    log::system(path.string() + ": cut off a packet that was not whole");
  }
}

void RotatingCapture::makeRoom(std::vector<File> files) const {
  std::erase_if(files, [](const File& file) { return !file.own; });
  std::uint64_t total = limits_.fileSize;  // of the file that is about to begin
  for (const File& file : files) total += file.size;
  const auto now = clock_.now();
  for (const File& file : files) {
    const bool old = limits_.keep && file.written + *limits_.keep < now;
    if (!old && total <= limits_.totalSize) continue;
    if (::unlink((folder_ / file.name).c_str()) == 0) {
      total -= file.size;
    } else if (errno != ENOENT) {
      log::system((folder_ / file.name).string() + ": cannot be removed: " + reasonOf(errno));
    }
  }
}

RotatingCapture::Problem RotatingCapture::begin() {
  file_.reset();
  if (Problem problem = holdFolder()) return problem;
  const std::vector<File> present = files();
  makeRoom(present);
  // A clock that was set back must not make the new file look older than those before it.
  auto time = std::chrono::floor<std::chrono::milliseconds>(clock_.now());
  if (!present.empty()) time = std::max(time, *recordingTime(present.back().name) + std::chrono::milliseconds(1));
  Result<capture::CaptureWriter> file = capture::CaptureWriter::create(
      folder_ / recordingName(time), capture::Flushing::inBlocks, capture::CaptureWriter::Existing::refuse);
  if (!file) return file.reason();
  file_.emplace(std::move(*file));
  begun_ = clock_.steady();
  return std::nullopt;
}

bool RotatingCapture::mustBegin(const MetricEvent& next) const {
  if (!file_ || file_->broken()) return true;
  if (file_->count() == 0) return false;
  return file_->size() + next.payload.size() + packetOverhead > limits_.fileSize ||
         clock_.steady() - begun_ >= limits_.fileAge;
}

RecordingOutcome RotatingCapture::write(std::span<const SharedEvent> events) {
  if (file_ && !file_->inPlace()) {
    log::system(file_->name() + ": is no longer there; another recording is begun");
    file_.reset();
  }
  RecordingOutcome all;
  while (!all.problem && all.taken < events.size()) {
    const std::span<const SharedEvent> rest = events.subspan(all.taken);
    if (mustBegin(*rest.front())) {
      all.problem = begin();
      if (all.problem) break;
    }
    const RecordingOutcome some = writeToFile(rest);
    all.taken += some.taken;
    all.refused += some.refused;
    all.problem = some.problem;
  }
  return all;
}

// Writes what the current file still takes.
RecordingOutcome RotatingCapture::writeToFile(std::span<const SharedEvent> events) {
  const std::uint64_t before = file_->count();
  std::vector<std::size_t> takenWith;  // with each packet, the number of events that are done with
  Problem problem;
  std::size_t index = 0;
  for (; index < events.size() && (index == 0 || !mustBegin(*events[index])); ++index) {
    problem = file_->write(*events[index]);
    if (problem && file_->unwritable()) break;
    if (!problem) takenWith.push_back(index + 1);
  }
  if (!problem || !file_->unwritable()) problem = file_->flush();
  const std::uint64_t packets = file_->count() - before;
  if (!problem) return {index, index - packets, std::nullopt};
  const std::size_t taken = packets == 0 ? 0 : takenWith[packets - 1];
  return {taken, taken - packets, problem};
}

}  // namespace vespscope::manager
