#include "manager/PeerConnection.h"

#include <sys/socket.h>
#include <unistd.h>

#include <chrono>
#include <utility>

namespace vespscope::manager {
namespace {

constexpr std::size_t unsentLimit = 256;  // the maximum number of answers that a client may leave unread
constexpr std::size_t turn = 64;          // events sent to the client before the next one's turn
// How long, and how many of, a client's messages are answered before the next client's turn; one more may be in
// progress.
constexpr std::chrono::microseconds answeringTime{500};
constexpr int answeringLimit = 64;

// Returns the process that connected to the other end of a socket. For pipes that is unknown: they are attributed to
// the user who started the program.
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

std::unique_ptr<PeerConnection> PeerConnection::open(ManagerCore& core, int input, int output,
                                                     std::shared_ptr<bus::MemoryBudget> budget) {
  std::unique_ptr<PeerConnection> connection(new PeerConnection(core, identityOf(input)));
  auto end = bus::ServerEnd::overPipes(input, output, connection->peer_, std::move(budget));
  if (!end) {
    core.refusals().write(end.reason());
    return nullptr;
  }
  connection->end_ = std::move(*end);
  return connection;
}

bool PeerConnection::work() {
  hasMore_ = peer_.sendEvents(*end_, turn) == turn;
  if (!answer()) return false;
  // The answer to a command is sent before the event that the command requested.
  hasMore_ = hasMore_ || peer_.sendEvents(*end_, turn) == turn;
  return end_->unsent() <= unsentLimit;
}

// Answers messages until none is left or the time has elapsed. If messages are left, wait() returns at once.
bool PeerConnection::answer() {
  const auto until = ManagerCore::Clock::now() + answeringTime;
  for (int count = 0; count < answeringLimit; ++count) {
    if (!end_->process(1)) return false;
    if (end_->wait().timeout != std::chrono::microseconds(0) || ManagerCore::Clock::now() >= until) break;
  }
  return true;
}

}  // namespace vespscope::manager
