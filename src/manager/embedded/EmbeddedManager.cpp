#include "manager/embedded/EmbeddedManager.h"

#include <sys/socket.h>

#include <array>
#include <cerrno>
#include <cstring>
#include <memory>
#include <utility>

#include "manager/PeerServer.h"
#include "sources/MakeSource.h"

namespace vespscope::manager {

Result<bus::EmbeddedEnd> startEmbeddedManager(const std::string& words) {
  Result<std::unique_ptr<sources::Source>> source = sources::makeSource(words);
  if (!source) return Failure{source.reason()};
  std::array<int, 2> ends{};
  if (::socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0, ends.data()) != 0) {
    return Failure{std::string("cannot create a socket pair: ") + std::strerror(errno)};
  }
  const auto server = std::make_shared<PeerServer>(std::move(*source));
  server->adopt(ends[1]);
  server->start();
  return bus::EmbeddedEnd{ends[0], server};
}

}  // namespace vespscope::manager
