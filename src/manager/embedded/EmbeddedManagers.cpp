#include "manager/embedded/EmbeddedManagers.h"

#include <sys/socket.h>

#include <array>
#include <cerrno>
#include <cstring>
#include <map>
#include <mutex>
#include <utility>

#include "manager/PeerServer.h"
#include "sources/MakeSource.h"

namespace vespscope::manager {

// Shared with the connections' threads.
class EmbeddedManagers::Servers {
 public:
  std::optional<std::string> open(const std::string& words) {
    const std::lock_guard lock(mutex_);
    const Result<Entry*> entry = find(words);
    if (!entry) return entry.reason();
    return std::nullopt;
  }

  Result<bus::EmbeddedEnd> connect(const std::string& words) {
    const std::lock_guard lock(mutex_);
    const Result<Entry*> found = find(words);
    if (!found) return Failure{found.reason()};
    Entry& entry = **found;
    std::array<int, 2> ends{};
    if (::socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0, ends.data()) != 0) {
      return Failure{std::string("cannot create a socket pair: ") + std::strerror(errno)};
    }
    entry.server->adopt(ends[1]);
    if (!std::exchange(entry.started, true)) entry.server->start();
    return bus::EmbeddedEnd{ends[0], entry.server};
  }

 private:
  struct Entry {
    std::shared_ptr<PeerServer> server;
    bool started = false;
  };

  // Returns the manager of a source, which is opened if there is none yet.
  Result<Entry*> find(const std::string& words) {
    if (const auto known = entries_.find(words); known != entries_.end()) return &known->second;
    Result<std::unique_ptr<sources::Source>> source = sources::makeSource(words);
    if (!source) return Failure{source.reason()};
    return &(entries_[words] = {std::make_shared<PeerServer>(std::move(*source)), false});
  }

  std::mutex mutex_;
  std::map<std::string, Entry> entries_;  // by the words of the source
};

EmbeddedManagers::EmbeddedManagers() : servers_(std::make_shared<Servers>()) {}
EmbeddedManagers::~EmbeddedManagers() = default;

std::optional<std::string> EmbeddedManagers::open(const std::string& words) { return servers_->open(words); }

bus::EmbeddedFactory EmbeddedManagers::factory() const {
  return [weak = std::weak_ptr(servers_)](const std::string& words) -> Result<bus::EmbeddedEnd> {
    const std::shared_ptr<Servers> servers = weak.lock();
    if (!servers) return Failure{std::string("the program is ending")};
    return servers->connect(words);
  };
}

}  // namespace vespscope::manager
