#include "manager/BusConnection.h"

#include <unistd.h>

#include <algorithm>
#include <utility>

#include <grp.h>

#include "platform/log/Log.h"

namespace vespscope::manager {
namespace {

constexpr std::size_t turn = 16;    // events sent to one client before the next client's turn
constexpr std::size_t rounds = 16;  // rounds over all clients before the next connection's turn

}  // namespace

BusAccess BusAccess::ofGroup(const std::string& name) {
  // Called before the first thread starts: getgrnam() returns static data.
  const struct group* found = ::getgrnam(name.c_str());  // NOLINT(concurrency-mt-unsafe)
  return found == nullptr ? BusAccess{} : BusAccess{found->gr_gid};
}

bool BusAccess::admits(const bus::ClientIdentity& client) const {
  if (client.user == 0 || client.user == ::geteuid()) return true;
  return group && std::find(client.groups.begin(), client.groups.end(), *group) != client.groups.end();
}

Result<std::unique_ptr<BusConnection>> BusConnection::open(ManagerCore& core, BusAccess access) {
  std::unique_ptr<BusConnection> connection(new BusConnection(core, access));
  auto end = bus::SystemBusEnd::open(*connection);
  if (!end) return Failure{end.reason()};
  connection->end_ = std::move(*end);
  return connection;
}

Result<bus::Service*> BusConnection::admit(const bus::ClientIdentity& client, bus::EventOutlet& outlet) {
  if (!access_.admits(client)) {
    core_.refusals().write("refused user " + std::to_string(client.user) + " on the system bus");
    return Failure{std::string("only the administrator and the manager's group may use it")};
  }
  return &clients_.try_emplace(client.busName, core_, client, outlet).first->second.peer;
}

bool BusConnection::work() {
  hasMore_ = sendEvents();
  if (!end_->process()) {
    log::system("the system bus has closed the connection");
    return false;
  }
  hasMore_ = hasMore_ || sendEvents();
  return true;
}

// All clients share the connection and are served in turn, so that a client with many events does not keep the others
// waiting.
bool BusConnection::sendEvents() {
  bool progress = true;
  for (std::size_t round = 0; progress && round < rounds; ++round) {
    progress = false;
    for (auto& [name, client] : clients_) progress = client.peer.sendEvents(client.outlet, turn) > 0 || progress;
  }
  return progress;
}

}  // namespace vespscope::manager
