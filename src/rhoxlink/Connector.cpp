#include "rhoxlink/Connector.h"

#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <string>

namespace rhox::client {
namespace {

using vespscope::Failure;
using vespscope::Result;
using vespscope::bus::EmbeddedEnd;
using vespscope::bus::EmbeddedFactory;

Result<EmbeddedEnd> openUnixSocket(const std::string& path) {
  sockaddr_un name{};
  name.sun_family = AF_UNIX;
  std::memcpy(name.sun_path, path.data(), path.size());  // Address bounds the length
  const int descriptor = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0);
  if (descriptor < 0) return Failure{std::string("no socket can be had: ") + std::strerror(errno)};
  if (::connect(descriptor, reinterpret_cast<const sockaddr*>(&name), sizeof name) == 0) {
    return EmbeddedEnd{descriptor, nullptr};
  }
  const int error = errno;
  ::close(descriptor);
  return Failure{"no manager at " + path + ": " + std::strerror(error)};
}

Result<EmbeddedEnd> openEmbedded(const std::string& source, const EmbeddedFactory& factory) {
  if (!factory) return Failure{std::string("this program has no baseband manager of its own")};
  return factory(source);
}

}  // namespace

Result<EmbeddedEnd> openSocket(const Address& address, const EmbeddedFactory& factory) {
  switch (address.kind) {
    case Address::Kind::none:
      return Failure{std::string("no manager is wanted")};
    case Address::Kind::unixSocket:
      return openUnixSocket(address.detail);
    case Address::Kind::embedded:
      return openEmbedded(address.detail, factory);
    case Address::Kind::automatic:
      return openEmbedded("scenario", factory);
    case Address::Kind::system:
      return Failure{std::string("this build cannot reach managers on the system bus")};
    case Address::Kind::ssh:
      return Failure{"this build cannot reach managers through ssh (" + address.detail + ")"};
  }
  return Failure{std::string("unknown kind of address")};
}

}  // namespace rhox::client
