#include "platform/files/NewFile.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <filesystem>
#include <utility>

#include <stdio.h>

namespace vespscope::files {
namespace {

using Problem = std::optional<std::string>;

constexpr mode_t ownerOnly = 0600;
constexpr int mostPartialFiles = 1000;

std::string reasonOf(int error) { return std::strerror(error); }

// "drive.partial.pcap" for "drive.pcap", then "drive.partial-2.pcap".
std::string partialNameOf(const std::filesystem::path& path, int number) {
  const std::string count = number == 1 ? "" : "-" + std::to_string(number);
  std::filesystem::path partial = path;
  partial.replace_filename(path.stem().string() + ".partial" + count + path.extension().string());
  return partial.string();
}

Problem problemWithExisting(const std::string& path, NewFile::Existing existing) {
  struct stat found {};
  if (::lstat(path.c_str(), &found) != 0) return std::nullopt;
  if (S_ISDIR(found.st_mode)) return path + ": is a folder";
  if (existing == NewFile::Existing::refuse) return path + ": exists already; --force replaces it";
  if (isBeingRead(path)) return path + ": is being read by another program";
  return std::nullopt;
}

// Renames a file unless the new name exists; returns an errno value or 0.
int renameToFreeName(const std::string& from, const std::string& to) {
  if (::renameat2(AT_FDCWD, from.c_str(), AT_FDCWD, to.c_str(), RENAME_NOREPLACE) == 0) return 0;
  if (errno != EINVAL && errno != ENOSYS) return errno;
  // On a file system without RENAME_NOREPLACE: link() fails as well if the name exists.
  if (::link(from.c_str(), to.c_str()) != 0) return errno;
  return ::unlink(from.c_str()) == 0 ? 0 : errno;
}

}  // namespace

bool isBeingRead(const std::string& path) {
  const int descriptor = ::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK);
  if (descriptor < 0) return false;
  const bool read = ::flock(descriptor, LOCK_EX | LOCK_NB) != 0 && errno == EWOULDBLOCK;
  ::close(descriptor);
  return read;
}

Result<NewFile> NewFile::create(const std::string& path, Existing existing) {
  if (Problem problem = problemWithExisting(path, existing)) return Failure{*std::move(problem)};
  NewFile file(path, existing);
  for (int number = 1; number <= mostPartialFiles; ++number) {
    file.partialName_ = partialNameOf(path, number);
    file.descriptor_ = ::open(file.partialName_.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, ownerOnly);
    if (file.descriptor_ >= 0) return file;
    if (errno != EEXIST) break;
  }
  return Failure{path + ": cannot be created: " + reasonOf(errno)};
}

NewFile::NewFile(NewFile&& other) noexcept
    : path_(std::move(other.path_)),
      partialName_(std::move(other.partialName_)),
      existing_(other.existing_),
      descriptor_(std::exchange(other.descriptor_, -1)) {}

NewFile::~NewFile() {
  if (descriptor_ >= 0) ::close(descriptor_);
}

std::optional<std::string> NewFile::finish() {
  if (::fsync(descriptor_) != 0) return partialName_ + ": cannot be written: " + reasonOf(errno);
  int error = 0;
  if (existing_ == Existing::refuse) {
    error = renameToFreeName(partialName_, path_);
  } else if (::rename(partialName_.c_str(), path_.c_str()) != 0) {
    error = errno;
  }
  if (error == EEXIST) return path_ + ": exists already; --force replaces it";
  if (error != 0) return path_ + ": cannot be created: " + reasonOf(error);
  return std::nullopt;
}

void NewFile::discard() { ::unlink(partialName_.c_str()); }

}  // namespace vespscope::files
