#include "sources/modemmanager/Probe.h"

#include <algorithm>
#include <memory>
#include <vector>

#include "rhoxlink/bus/BusClient.h"
#include "sources/modemmanager/Names.h"
#include "sources/modemmanager/ObjectTree.h"

namespace vespscope::sources::modemmanager {

namespace {

// The objects of ModemManager; empty where it does not run.
std::optional<ObjectTree> objectsOfModemManager(std::chrono::milliseconds limit) {
  const Result<std::unique_ptr<bus::BusClient>> bus = bus::BusClient::openSystem();
  if (!bus) return std::nullopt;
  const bus::BusClient::Answer answer =
      (*bus)->ask({service, rootPath, objectManagerInterface, "GetManagedObjects", {}}, limit);
  if (!answer || answer->size() != 1 || answer->front().asDictionary() == nullptr) return std::nullopt;
  ObjectTree tree;
  tree.replace(*answer->front().asDictionary());
  return tree;
}

}  // namespace

bool modemManagerHasModem(std::chrono::milliseconds limit) {
  const auto tree = objectsOfModemManager(limit);
  return tree && !tree->pathsWith(modemInterface).empty();
}

ModemManagerPort modemManagerPort(const std::string& name, std::chrono::milliseconds limit) {
  ModemManagerPort port;
  const auto tree = objectsOfModemManager(limit);
  if (!tree) return port;
  port.running = true;
  for (const std::string& path : tree->pathsWith(modemInterface)) {
    const Told modem = tree->at(path, modemInterface);
    const std::vector<std::string> ports = modem.firstTexts("Ports");
    if (std::find(ports.begin(), ports.end(), name) == ports.end()) continue;
    port.modem = path.substr(path.rfind('/') + 1);
    port.device = modem.text("Device");
  }
  return port;
}

}  // namespace vespscope::sources::modemmanager
