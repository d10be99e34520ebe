#include "manager/ListeningSocket.h"

#include <fcntl.h>
#include <sys/file.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <unistd.h>

#include <cerrno>
#include <chrono>
#include <cstring>
#include <optional>
#include <thread>
#include <utility>

namespace vespscope::manager {
namespace {

constexpr mode_t ownerOnly = S_IRUSR | S_IWUSR;
constexpr int backlog = 16;  // connections

sockaddr_un nameOf(const std::string& path) {
  sockaddr_un name{};
  name.sun_family = AF_UNIX;
  std::memcpy(name.sun_path, path.data(), path.size());
  return name;
}

int makeSocket() { return ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0); }

// Returns why `path` cannot be used; empty when the path is free.
std::optional<std::string> clearStale(const std::string& path) {
  struct stat status {};
  if (::lstat(path.c_str(), &status) != 0) return std::nullopt;  // bind() reports any other error
  if (!S_ISSOCK(status.st_mode)) return path + " exists and is not a socket";
  const int probe = makeSocket();
  if (probe < 0) return "cannot check for a manager at " + path + ": " + std::strerror(errno);
  const sockaddr_un name = nameOf(path);
  const int result = ::connect(probe, reinterpret_cast<const sockaddr*>(&name), sizeof name);
  const int error = result == 0 ? 0 : errno;
  ::close(probe);
  if (error == 0 || error == EAGAIN) return "another manager listens at " + path;
  if (error != ECONNREFUSED) return "cannot check for a manager at " + path + ": " + std::strerror(error);
  ::unlink(path.c_str());
  return std::nullopt;
}

// Held while a socket is created: of several managers that start at once, one creates the socket and the others find
// it.
class PlaceLock {
 public:
  // Waits for any other manager that is starting.
  static Result<PlaceLock> of(const std::string& path) {
    const std::string file = path + ".lock";
    const auto failure = [&file](const char* reason) { return Failure{"cannot lock " + file + ": " + reason}; };
    for (int attempt = 0; attempt < attemptLimit; ++attempt) {
      const int descriptor = ::open(file.c_str(), O_RDWR | O_CREAT | O_CLOEXEC | O_NOFOLLOW | O_NONBLOCK, ownerOnly);
      if (descriptor < 0) return Failure{"cannot listen at " + path + ": " + std::strerror(errno)};
      PlaceLock lock(descriptor, file);
      if (::flock(descriptor, LOCK_EX | LOCK_NB) != 0) {
        if (errno != EWOULDBLOCK && errno != EINTR) return failure(std::strerror(errno));
        std::this_thread::sleep_for(attemptPause);
        continue;
      }
      lock.locked_ = true;
      if (lock.isInPlace()) return lock;
      lock.locked_ = false;  // the previous holder has removed the file meanwhile
    }
    return failure("another starting manager holds the lock");
  }
  PlaceLock(PlaceLock&& other) noexcept
      : descriptor_(std::exchange(other.descriptor_, -1)), file_(std::move(other.file_)), locked_(other.locked_) {}
  PlaceLock& operator=(PlaceLock&&) = delete;
  ~PlaceLock() {
    if (descriptor_ < 0) return;
    if (locked_) ::unlink(file_.c_str());
    ::close(descriptor_);
  }

 private:
  static constexpr int attemptLimit = 1000;
  static constexpr std::chrono::milliseconds attemptPause{2};

  PlaceLock(int descriptor, std::string file) : descriptor_(descriptor), file_(std::move(file)) {}
  [[nodiscard]] bool isInPlace() const {
    struct stat here {};
    struct stat there {};
    return ::fstat(descriptor_, &here) == 0 && ::lstat(file_.c_str(), &there) == 0 && here.st_dev == there.st_dev &&
           here.st_ino == there.st_ino;
  }

  int descriptor_;
  std::string file_;
  bool locked_ = false;
};

}  // namespace

ListeningSocket::ListeningSocket(int descriptor, std::string path) : descriptor_(descriptor), path_(std::move(path)) {
  struct stat status {};
  if (::lstat(path_.c_str(), &status) == 0) {
    device_ = status.st_dev;
    inode_ = status.st_ino;
  }
}

ListeningSocket::ListeningSocket(ListeningSocket&& other) noexcept
    : descriptor_(std::exchange(other.descriptor_, -1)),
      path_(std::move(other.path_)),
      device_(other.device_),
      inode_(other.inode_) {}

ListeningSocket::~ListeningSocket() {
  if (descriptor_ < 0) return;
  struct stat status {};
  if (::lstat(path_.c_str(), &status) == 0 && status.st_dev == device_ && status.st_ino == inode_) {
    ::unlink(path_.c_str());
  }
  ::close(descriptor_);
}

Result<ListeningSocket> ListeningSocket::at(const std::string& path) {
  if (path.empty() || path.size() >= sizeof(sockaddr_un::sun_path)) {
    return Failure{"a socket's path has 1 to " + std::to_string(sizeof(sockaddr_un::sun_path) - 1) + " bytes: " + path};
  }
  const Result<PlaceLock> lock = PlaceLock::of(path);
  if (!lock) return Failure{lock.reason()};
  if (std::optional<std::string> obstacle = clearStale(path)) return Failure{*obstacle};
  const int descriptor = makeSocket();
  const sockaddr_un name = nameOf(path);
  // The file gets the socket's mode on creation, so that it is not accessible to others even for a moment.
  if (descriptor < 0 || ::fchmod(descriptor, ownerOnly) != 0 ||
      ::bind(descriptor, reinterpret_cast<const sockaddr*>(&name), sizeof name) != 0) {
    const int error = errno;
    if (descriptor >= 0) ::close(descriptor);
    return Failure{"cannot listen at " + path + ": " + std::strerror(error)};
  }
  ListeningSocket socket(descriptor, path);
  if (::listen(descriptor, backlog) != 0) return Failure{"cannot listen at " + path + ": " + std::strerror(errno)};
  return socket;
}

ListeningSocket::Accepted ListeningSocket::accept() const {
  while (true) {
    const int connection = ::accept4(descriptor_, nullptr, nullptr, SOCK_CLOEXEC | SOCK_NONBLOCK);
    if (connection < 0) {
      if (errno == EINTR || errno == ECONNABORTED) continue;
      return {errno == EAGAIN || errno == EWOULDBLOCK ? Outcome::noneWaits : Outcome::exhausted, -1, {}};
    }
    ucred peer{};
    socklen_t size = sizeof peer;
    const bool known = ::getsockopt(connection, SOL_SOCKET, SO_PEERCRED, &peer, &size) == 0;
    if (known && (peer.uid == ::geteuid() || peer.uid == 0)) return {Outcome::accepted, connection, {}};
    ::close(connection);
    return {Outcome::refused, -1, "refused a connection of user " + (known ? std::to_string(peer.uid) : "unknown")};
  }
}

}  // namespace vespscope::manager
