#include "rhoxlink/Rhoxlink.h"

#include <cstdlib>
#include <mutex>
#include <utility>

#include "rhoxlink/Connector.h"
#include "rhoxlink/Manager.h"
#include "rhoxlink/bus/Bus.h"
#include "rhoxlink/bus/BusClient.h"

namespace rhox::client {
namespace {

struct Settings {
  std::mutex mutex;
  std::optional<Address> address;
  vespscope::bus::EmbeddedFactory factory;
  std::function<bool()> modemProbe;
  Afterwards afterwards;
  std::chrono::milliseconds timeout{2000};
};

// Never destroyed: a manager may be made or used while the process exits.
Settings& settings() {
  static Settings* shared = new Settings;
  return *shared;
}

}  // namespace

void setAddress(Address address) {
  const std::lock_guard lock(settings().mutex);
  settings().address = std::move(address);
}

vespscope::Result<Address> address() {
  {
    const std::lock_guard lock(settings().mutex);
    if (settings().address) return *settings().address;
  }
  const char* words = std::getenv("RHOX_ADDRESS");
  if (words == nullptr || *words == '\0') return Address{};
  vespscope::Result<Address> parsed = Address::parse(words);
  if (!parsed) return vespscope::Failure{"RHOX_ADDRESS: " + parsed.reason()};
  return parsed;
}

void setEmbeddedFactory(vespscope::bus::EmbeddedFactory factory) {
  const std::lock_guard lock(settings().mutex);
  settings().factory = std::move(factory);
}

void setModemProbe(std::function<bool()> probe) {
  const std::lock_guard lock(settings().mutex);
  settings().modemProbe = std::move(probe);
}

void setAfterwards(Afterwards afterwards) {
  const std::lock_guard lock(settings().mutex);
  settings().afterwards = std::move(afterwards);
}

void setCommandTimeout(std::chrono::milliseconds timeout) {
  const std::lock_guard lock(settings().mutex);
  settings().timeout = timeout;
}

std::chrono::milliseconds commandTimeout() {
  const std::lock_guard lock(settings().mutex);
  return settings().timeout;
}

std::shared_ptr<Manager> CreateManager(const std::string& name,
                                       std::shared_ptr<vespscope::dispatch::SerialQueue> queue) {
  vespscope::bus::EmbeddedFactory factory;
  std::function<bool()> modemProbe;
  Afterwards afterwards;
  {
    const std::lock_guard lock(settings().mutex);
    factory = settings().factory;
    modemProbe = settings().modemProbe;
    afterwards = settings().afterwards;
  }
  vespscope::Result<Address> where = address();
  // Resolved once: after the connection to a manager is lost, the same kind of manager is tried again, not another.
  if (where && where->kind == Address::Kind::automatic) {
    where = resolveAutomatic(
        {[] { return vespscope::bus::isOnSystemBus(vespscope::bus::serviceName); }, std::move(modemProbe)});
  }
  return std::make_shared<Manager>(name, std::move(where), std::move(factory), std::move(queue), std::move(afterwards));
}

// Each call holds its own reference to the manager until it returns. NOLINTBEGIN(performance-unnecessary-value-param)
Result PerformCommand(std::shared_ptr<Manager> manager, std::string_view command,
                      const vespscope::ipc::Dictionary& request, vespscope::ipc::Object& reply) {
  return manager->perform(command, request, reply, commandTimeout());
}

void RegisterEventHandler(std::shared_ptr<Manager> manager, std::string_view event, EventHandler handler) {
  manager->setHandler(event, std::move(handler));
}

void RegisterEventObserver(std::shared_ptr<Manager> manager, std::string_view event, EventObserver observer) {
  manager->setObserver(event, std::move(observer));
}

void EventsOn(std::shared_ptr<Manager> manager) { manager->setEvents(true); }
void EventsOff(std::shared_ptr<Manager> manager) { manager->setEvents(false); }

ConnectionStatus connectionStatus(std::shared_ptr<Manager> manager) { return manager->status(); }
// NOLINTEND(performance-unnecessary-value-param)

}  // namespace rhox::client
