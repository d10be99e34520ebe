#include "manager/recording/RotatingCapture.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <cstring>
#include <iterator>
#include <string_view>
#include <system_error>
#include <utility>

#include "platform/log/Log.h"

namespace vespscope::manager {
namespace {

constexpr mode_t ownerOnly = 0700;
constexpr std::string_view unfinished = capture::PcapOutput::unfinished;
constexpr std::uint64_t packetOverhead = 64;  // maximum bytes of a packet in addition to its payload

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
  ::mkdir(folder_.c_str(), ownerOnly);  // if this fails, the next call reports it
  const int folder = ::open(folder_.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC);
  if (folder < 0) return folder_.string() + ": cannot record into this folder: " + reasonOf(errno);
  if (::flock(folder, LOCK_EX | LOCK_NB) != 0) {
    const int reason = errno;
    ::close(folder);
    return folder_.string() + (reason == EWOULDBLOCK ? ": another program is recording into it"
                                                     : ": cannot record into this folder: " + reasonOf(reason));
  }
  held_ = folder;
  files_.clear();
  folderTime_ = {};
  if (::access(folder_.c_str(), W_OK | X_OK) != 0) {
    return folder_.string() + ": cannot record into this folder: " + reasonOf(errno);
  }
  readFolder();
  repairLast();
  return std::nullopt;
}

// Whether another program has added or removed a file since the last look. A change within the same tick of the file
// system's clock as this recorder's own is detected with the next change.
bool RotatingCapture::folderChanged() const {
  struct stat folder {};
  return ::fstat(held_, &folder) != 0 || folder.st_mtim.tv_sec != folderTime_.tv_sec ||
         folder.st_mtim.tv_nsec != folderTime_.tv_nsec;
}

void RotatingCapture::rememberFolder() {
  struct stat folder {};
  if (::fstat(held_, &folder) == 0) folderTime_ = folder.st_mtim;
}

// Lists the recordings in the folder, of which there may be many. Removes the temporary files of a run that was killed.
void RotatingCapture::readFolder() {
  rememberFolder();
  files_.clear();
  total_ = 0;
  std::error_code error;
  for (std::filesystem::directory_iterator entry(folder_, error), end; !error && entry != end; entry.increment(error)) {
    const std::string name = entry->path().filename().string();
    if (name.ends_with(unfinished) && recordingTime(name.substr(0, name.size() - unfinished.size()))) {
      ::unlink(entry->path().c_str());
    }
    struct stat file {};
    if (!recordingTime(name) || ::lstat(entry->path().c_str(), &file) != 0) continue;
    const bool own = S_ISREG(file.st_mode) && file.st_uid == ::geteuid();
    files_[name] = {static_cast<std::uint64_t>(file.st_size), timeOf(file.st_mtim), own};
    if (own) total_ += static_cast<std::uint64_t>(file.st_size);
  }
}

void RotatingCapture::repairLast() {
  const auto last = std::find_if(files_.rbegin(), files_.rend(), [](const auto& entry) { return entry.second.own; });
  if (last == files_.rend()) return;
  const std::filesystem::path path = folder_ / last->first;
  const Result<capture::WholePart> whole = capture::cutToWholePackets(path);
  if (!whole) {
    log::system(path.string() + ": " + whole.reason());
  } else if (whole->bytes == 0) {
    ::unlink(path.c_str());
    total_ -= last->second.size;
    files_.erase(std::next(last).base());
  } else if (whole->bytes < last->second.size) {
    log::system(path.string() + ": removed " + std::to_string(last->second.size - whole->bytes) +
                " bytes after the last whole packet");
    total_ -= last->second.size - whole->bytes;
    last->second.size = whole->bytes;
  }
}

// Removes the oldest files. There may be very many, so the loop ends at the first file that stays.
void RotatingCapture::makeRoom() {
  const auto now = clock_.now();
  for (auto entry = files_.begin(); entry != files_.end();) {
    const auto& [name, file] = *entry;
    const bool old = limits_.keep && file.written + *limits_.keep < now;
    if (file.own && !old && total_ + limits_.fileSize <= limits_.totalSize) return;
    if (!file.own) {
      ++entry;
    } else if (::unlink((folder_ / name).c_str()) == 0 || errno == ENOENT) {
      total_ -= file.size;
      entry = files_.erase(entry);
    } else {
      log::system((folder_ / name).string() + ": cannot be removed: " + reasonOf(errno));
      ++entry;
    }
  }
}

// Returns the name of the next file. After a clock was set back, a new file must not sort before earlier ones. A name
// far in the future, which no such clock gave, is not continued.
RecordingTime RotatingCapture::nextTime() const {
  constexpr std::chrono::years farthest{100};
  auto time = std::chrono::floor<std::chrono::milliseconds>(clock_.now());
  const std::string end = recordingName(time + farthest);
  auto after = files_.lower_bound(end);
  while (after != files_.begin()) {
    --after;
    if (!after->second.own) continue;
    time = std::max(time, *recordingTime(after->first) + std::chrono::milliseconds(1));
    break;
  }
  while (files_.contains(recordingName(time))) time += std::chrono::milliseconds(1);
  return time;
}

// Closes the current file with its final size and time.
void RotatingCapture::end() {
  if (!file_) return;
  const std::filesystem::path path = file_->name();
  file_.reset();
  struct stat file {};
  const auto entry = files_.find(path.filename().string());
  if (entry == files_.end() || ::lstat(path.c_str(), &file) != 0) return;
  total_ += static_cast<std::uint64_t>(file.st_size) - entry->second.size;
  entry->second.size = static_cast<std::uint64_t>(file.st_size);
  entry->second.written = timeOf(file.st_mtim);
}

RotatingCapture::Problem RotatingCapture::begin() {
  end();
  if (Problem problem = holdFolder()) return problem;
  if (folderChanged()) readFolder();
  makeRoom();
  const std::string name = recordingName(nextTime());
  Result<capture::CaptureWriter> file = capture::CaptureWriter::create(folder_ / name, capture::Flushing::inBlocks,
                                                                       capture::CaptureWriter::Existing::refuse);
  if (!file) {
    folderTime_ = {};  // the folder has changed
    return file.reason();
  }
  file_.emplace(std::move(*file));
  files_[name] = {file_->size(), clock_.now(), true};
  total_ += file_->size();
  rememberFolder();
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
  RecordingOutcome all;
  if (file_ && !file_->inPlace()) {
    log::system(file_->name() + ": has been removed; a new recording begins");
    end();
  } else if (file_ && file_->wasChanged()) {
    all.removed = leaveChangedFile();
  }
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

// Repairs what another program has left of the file, and returns how many of its events are gone.
std::uint64_t RotatingCapture::leaveChangedFile() {
  const std::string name = file_->name();
  const std::uint64_t events = file_->count();
  file_.reset();
  const Result<capture::WholePart> whole = capture::cutToWholePackets(name);
  const std::uint64_t left = whole ? std::min(whole->packets, events) : 0;
  log::system(name + ": was changed by another program, " + std::to_string(events - left) +
              " of its events are lost; a new recording begins");
  folderTime_ = {};
  return events - left;
}

// Writes the events that fit into the current file.
RecordingOutcome RotatingCapture::writeToFile(std::span<const SharedEvent> events) {
  const std::uint64_t before = file_->count();
  std::vector<std::size_t> takenWith;  // for each packet, the number of events completed with it
  Problem problem;
  std::size_t index = 0;
  for (; index < events.size() && (index == 0 || !mustBegin(*events[index])); ++index) {
    problem = file_->write(*events[index]);
    if (problem && file_->unwritable()) break;
    if (!problem) takenWith.push_back(index + 1);
  }
  if (!problem || !file_->unwritable()) problem = file_->flush();
  const std::uint64_t packets = file_->count() - before;
  if (!problem) return {.taken = index, .refused = index - packets, .removed = 0, .problem = std::nullopt};
  const std::size_t taken = packets == 0 ? 0 : takenWith[packets - 1];
  return {.taken = taken, .refused = taken - packets, .removed = 0, .problem = problem};
}

}  // namespace vespscope::manager
