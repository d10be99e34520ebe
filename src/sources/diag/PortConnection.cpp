#include "sources/diag/PortConnection.h"

#include <fcntl.h>
#include <netinet/in.h>
#include <netinet/tcp.h>
#include <sys/socket.h>
#include <termios.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <memory>
#include <string_view>
#include <utility>

#include <netdb.h>

namespace vespscope::sources::diag {
namespace {

constexpr std::string_view tcpPrefix = "tcp:";

Failure<std::string> systemFailure() { return Failure{std::string(std::strerror(errno))}; }

bool isRetry(int error) { return error == EAGAIN || error == EWOULDBLOCK || error == EINTR; }

using Addresses = std::unique_ptr<addrinfo, decltype(&::freeaddrinfo)>;

// The address in "tcp:ADDRESS:PORT"; null if it is invalid.
Addresses addressOf(const std::string& name) {
  Addresses none(nullptr, &::freeaddrinfo);
  std::string host = name.substr(tcpPrefix.size());
  const std::size_t colon = host.rfind(':');
  if (colon == std::string::npos || colon == 0) return none;
  const std::string port = host.substr(colon + 1);
  host.resize(colon);
  if (host.front() == '[' && host.back() == ']') host = host.substr(1, host.size() - 2);
  if (host == "localhost") host = "127.0.0.1";
  addrinfo hints{};
  hints.ai_socktype = SOCK_STREAM;
  hints.ai_flags = AI_NUMERICHOST | AI_NUMERICSERV;
  addrinfo* found = nullptr;
  if (port.empty() || ::getaddrinfo(host.c_str(), port.c_str(), &hints, &found) != 0) return none;
  return {found, &::freeaddrinfo};
}

Result<int> openTcp(const std::string& name) {
  const Addresses address = addressOf(name);
  if (!address) return Failure{*problemWithTcpPort(name)};
  const int descriptor = ::socket(address->ai_family, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0);
  if (descriptor < 0) return systemFailure();
  const int on = 1;
  ::setsockopt(descriptor, IPPROTO_TCP, TCP_NODELAY, &on, sizeof on);
  // The only way to detect that the machine at the other end has vanished.
  ::setsockopt(descriptor, SOL_SOCKET, SO_KEEPALIVE, &on, sizeof on);
  if (::connect(descriptor, address->ai_addr, address->ai_addrlen) != 0 && errno != EINPROGRESS) {
    auto failure = systemFailure();
    ::close(descriptor);
    return failure;
  }
  return descriptor;
}

Result<int> openDevice(const std::string& path) {
  const int descriptor = ::open(path.c_str(), O_RDWR | O_NOCTTY | O_NONBLOCK | O_CLOEXEC);
  if (descriptor < 0) return systemFailure();
  termios line{};
  // A port that is not a serial line needs no settings.
  if (::tcgetattr(descriptor, &line) != 0) return descriptor;
  ::cfmakeraw(&line);
  line.c_cflag |= CLOCAL | CREAD;
  ::cfsetspeed(&line, B115200);
  if (::tcsetattr(descriptor, TCSANOW, &line) != 0) {
    auto failure = systemFailure();
    ::close(descriptor);
    return failure;
  }
  return descriptor;
}

}  // namespace

Result<PortConnection> PortConnection::open(const std::string& name) {
  const Result<int> descriptor = name.starts_with(tcpPrefix) ? openTcp(name) : openDevice(name);
  if (!descriptor) return Failure{descriptor.reason()};
  return PortConnection(*descriptor);
}

PortConnection::PortConnection(PortConnection&& other) noexcept : descriptor_(std::exchange(other.descriptor_, -1)) {}

PortConnection::~PortConnection() {
  if (descriptor_ >= 0) ::close(descriptor_);
}

Result<std::size_t> PortConnection::read(std::span<std::uint8_t> buffer) {
  const ssize_t count = ::read(descriptor_, buffer.data(), buffer.size());
  if (count > 0) return static_cast<std::size_t>(count);
  if (count == 0) return Failure{std::string("it has been closed")};
  if (isRetry(errno)) return std::size_t{0};
  return systemFailure();
}

Result<std::size_t> PortConnection::write(Bytes& bytes) {
  // Writing to a connection that was closed at its other end must not end the process with SIGPIPE.
  ssize_t count = ::send(descriptor_, bytes.data(), bytes.size(), MSG_NOSIGNAL);
  if (count < 0 && errno == ENOTSOCK) count = ::write(descriptor_, bytes.data(), bytes.size());
  if (count < 0) {
    // ENOTCONN: the connection is not established yet.
    if (isRetry(errno) || errno == ENOTCONN) return std::size_t{0};
    return systemFailure();
  }
  bytes.erase(bytes.begin(), bytes.begin() + count);
  return static_cast<std::size_t>(count);
}

std::optional<std::string> problemWithTcpPort(const std::string& name) {
  if (addressOf(name)) return std::nullopt;
  return "a TCP port is tcp:ADDRESS:PORT, both numbers, such as tcp:127.0.0.1:5000";
}

}  // namespace vespscope::sources::diag
