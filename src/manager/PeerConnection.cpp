#include "manager/PeerConnection.h"

#include <sys/socket.h>
#include <unistd.h>

#include <utility>

#include "platform/log/Log.h"

namespace vespscope::manager {
namespace {

constexpr std::size_t unsentLimit = 256;  // answers that a client may leave unread
constexpr std::size_t turn = 64;          // events that it gets before it is another's turn

// Who made the other end of a socket. Pipes do not tell: they were given by whoever started this program.
bus::ClientIdentity identityOf(int descriptor) {
  bus::ClientIdentity identity{.user = ::geteuid(), .groups = {}, .process = 0, .busName = {}};
  ucred peer{};
  socklen_t size = sizeof peer;
  if (::getsockopt(descriptor, SOL_SOCKET, SO_PEERCRED, &peer, &size) == 0) {
    identity.user = peer.uid;
    identity.process = peer.pid;
  }
  return identity;
}

}  // namespace

std::unique_ptr<PeerConnection> PeerConnection::open(ManagerCore& core, int input, int output) {
  std::unique_ptr<PeerConnection> connection(new PeerConnection(core, identityOf(input)));
  auto end = bus::ServerEnd::overPipes(input, output, connection->peer_);
  if (!end) {
    log::system(end.reason());
    return nullptr;
  }
  connection->end_ = std::move(*end);
  return connection;
}

bool PeerConnection::work() {
  hasMore_ = peer_.sendEvents(*end_, turn) == turn;
  if (!end_->process()) return false;
  // A command's answer goes out before the event it asked for.
  hasMore_ = hasMore_ || peer_.sendEvents(*end_, turn) == turn;
  return end_->unsent() <= unsentLimit;
}

}  // namespace vespscope::manager
