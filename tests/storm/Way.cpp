#include "storm/Way.h"

#include <fcntl.h>
#include <poll.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstring>
#include <stdexcept>
#include <utility>
#include <vector>

namespace vespscope::test {
namespace {

sockaddr_un addressOf(const std::string& path) {
  sockaddr_un name{};
  name.sun_family = AF_UNIX;
  std::strncpy(name.sun_path, path.c_str(), sizeof name.sun_path - 1);
  return name;
}

}  // namespace

int connectTo(const std::string& path) {
  const int descriptor = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
  const sockaddr_un name = addressOf(path);
  if (::connect(descriptor, reinterpret_cast<const sockaddr*>(&name), sizeof name) == 0) return descriptor;
  ::close(descriptor);
  return -1;
}

Way::Way(std::string path, std::string manager) : path_(std::move(path)), manager_(std::move(manager)) {
  listening_ = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0);
  const sockaddr_un name = addressOf(path_);
  if (::bind(listening_, reinterpret_cast<const sockaddr*>(&name), sizeof name) != 0 || ::listen(listening_, 16) != 0) {
    throw std::runtime_error(path_ + ": " + std::strerror(errno));
  }
  thread_ = std::thread([this] { run(); });
}

Way::~Way() {
  stopping_ = true;
  thread_.join();
  for (const Pair& pair : pairs_) {
    ::close(pair.up.from);
    ::close(pair.up.to);
  }
  ::close(listening_);
}

void Way::accept() {
  const int client = ::accept4(listening_, nullptr, nullptr, SOCK_CLOEXEC | SOCK_NONBLOCK);
  if (client < 0) return;
  const int manager = connectTo(manager_);
  if (manager < 0) {
    ::close(client);
    return;
  }
  ::fcntl(manager, F_SETFL, ::fcntl(manager, F_GETFL) | O_NONBLOCK);
  pairs_.push_back({{client, manager, {}}, {manager, client, {}}});
}

bool Way::move(Stream& stream, bool cut) const {
  if (stream.waiting.empty()) {
    std::array<char, 16384> piece;
    const ssize_t count = ::recv(stream.from, piece.data(), piece.size(), 0);
    if (count == 0 || (count < 0 && errno != EAGAIN)) return false;
    if (count > 0) stream.waiting.assign(piece.data(), static_cast<std::size_t>(count));
  }
  if (stream.waiting.empty()) return true;
  // An odd part, so that it ends within a message.
  const std::size_t most = cut ? stream.waiting.size() / 2 | 1 : stream.waiting.size();
  const ssize_t sent = ::send(stream.to, stream.waiting.data(), most, MSG_NOSIGNAL);
  if (sent < 0 && errno != EAGAIN) return false;
  if (sent > 0) stream.waiting.erase(0, static_cast<std::size_t>(sent));
  return !cut;
}

void Way::run() {
  while (!stopping_) {
    std::vector<pollfd> ready = {{listening_, POLLIN, 0}};
    for (const Pair& pair : pairs_) {
      for (const Stream* stream : {&pair.up, &pair.down}) {
        const bool holds = !stream->waiting.empty();
        ready.push_back({holds ? stream->to : stream->from, static_cast<short>(holds ? POLLOUT : POLLIN), 0});
      }
    }
    constexpr int pause = 20;  // ms
    ::poll(ready.data(), still_ ? 0 : ready.size(), pause);
    if (still_) continue;
    std::size_t place = 1;
    bool anyCut = false;
    for (auto pair = pairs_.begin(); pair != pairs_.end();) {
      const bool up = ready[place].revents != 0;
      const bool down = ready[place + 1].revents != 0;
      place += 2;
      const bool cut = cutting_ && down;
      anyCut = anyCut || cut;
      const bool alive = (!up || move(pair->up, false)) && (!down || move(pair->down, cut));
      if (alive) {
        ++pair;
        continue;
      }
      if (cut) ++cuts_;
      ::close(pair->up.from);
      ::close(pair->up.to);
      pair = pairs_.erase(pair);
    }
    if (anyCut || pairs_.empty()) cutting_ = false;
    if (ready[0].revents != 0) accept();
  }
}

}  // namespace vespscope::test
