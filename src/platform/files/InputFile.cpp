#include "platform/files/InputFile.h"

#include <fcntl.h>
#include <poll.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstring>
#include <string_view>
#include <utility>

namespace vespscope::files {
namespace {

std::string unopened(int error) { return "cannot be opened: " + std::string(std::strerror(error)); }
std::string unread(int error) { return "cannot be read: " + std::string(std::strerror(error)); }

// Whether the path names a descriptor of this process, as a shell passes it for <(COMMAND).
bool namesDescriptor(std::string_view path) {
  return path == "-" || path == "/dev/stdin" || path.starts_with("/dev/fd/") || path.starts_with("/proc/self/fd/");
}

std::string wrongKind(mode_t mode) {
  if (S_ISDIR(mode)) return "is a folder, not a file";
  if (S_ISFIFO(mode)) return "is a pipe, not a file; read it through standard input (-)";
  return S_ISSOCK(mode) ? "is a socket, not a file" : "is a device, not a file";
}

}  // namespace

Result<std::unique_ptr<InputFile>> InputFile::open(const std::string& path,
                                                   std::shared_ptr<const dispatch::WakeDescriptor> interruption) {
  // Without O_NONBLOCK, opening a pipe waits for its writer.
  const int descriptor = path == "-" ? ::fcntl(STDIN_FILENO, F_DUPFD_CLOEXEC, STDERR_FILENO + 1)
                                     : ::open(path.c_str(), O_RDONLY | O_CLOEXEC | O_NONBLOCK | O_NOCTTY);
  if (descriptor < 0) return Failure{unopened(errno)};
  std::unique_ptr<InputFile> file(new InputFile(descriptor, std::move(interruption)));
  if (auto reason = file->examine(namesDescriptor(path))) return Failure{*std::move(reason)};
  return file;
}

InputFile::~InputFile() { ::close(descriptor_); }

std::optional<std::string> InputFile::examine(bool inherited) {
  struct stat found {};
  if (::fstat(descriptor_, &found) != 0) return unopened(errno);
  identity_ = {found.st_dev, found.st_ino};
  if ((::fcntl(descriptor_, F_GETFL) & O_ACCMODE) == O_WRONLY) return "is not open for reading";
  if (S_ISDIR(found.st_mode) || (!inherited && !S_ISREG(found.st_mode))) return wrongKind(found.st_mode);
  const off_t begin = S_ISREG(found.st_mode) ? ::lseek(descriptor_, 0, inherited ? SEEK_CUR : SEEK_SET) : -1;
  if (begin >= 0) size_ = static_cast<std::uint64_t>(found.st_size);
  // Another program that would replace this file finds the lock. File systems without locks give no such protection.
  if (!inherited) ::flock(descriptor_, LOCK_SH | LOCK_NB);
  return std::nullopt;
}

bool InputFile::wait() {
  std::array<pollfd, 2> waiting = {{{descriptor_, POLLIN, 0}, {-1, POLLIN, 0}}};
  if (interruption_) waiting[1].fd = interruption_->descriptor();
  while (::poll(waiting.data(), waiting.size(), -1) < 0 && errno == EINTR) {
  }
  interrupted_ = waiting[1].revents != 0;
  return !interrupted_;
}

Result<std::size_t> InputFile::read(std::span<std::uint8_t> bytes) {
  while (wait()) {
    const ssize_t count = ::read(descriptor_, bytes.data(), bytes.size());
    if (count >= 0) {
      position_ += static_cast<std::size_t>(count);
      return static_cast<std::size_t>(count);
    }
    if (errno != EINTR && errno != EAGAIN) return Failure{unread(errno)};
  }
  return std::size_t{0};
}

std::optional<std::string> InputFile::rewind() {
  if (::lseek(descriptor_, 0, SEEK_SET) != 0) return "cannot be read again: " + std::string(std::strerror(errno));
  position_ = 0;
  return std::nullopt;
}

Result<Bytes> readBeginning(const std::string& path, std::size_t limit) {
  const auto file = InputFile::open(path);
  if (!file) return Failure{file.reason()};
  if (!(*file)->canRewind()) return Failure{std::string("is not a regular file")};
  Bytes bytes(limit);
  std::size_t length = 0;
  while (length < limit) {
    const Result<std::size_t> count = (*file)->read(std::span(bytes).subspan(length));
    if (!count) return Failure{count.reason()};
    if (*count == 0) break;
    length += *count;
  }
  bytes.resize(length);
  return bytes;
}

}  // namespace vespscope::files
