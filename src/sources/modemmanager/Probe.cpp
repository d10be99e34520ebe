#include "sources/modemmanager/Probe.h"

#include <memory>

#include "rhoxlink/bus/BusClient.h"
#include "sources/modemmanager/Names.h"
#include "sources/modemmanager/ObjectTree.h"

namespace vespscope::sources::modemmanager {

bool modemManagerHasModem(std::chrono::milliseconds limit) {
  const Result<std::unique_ptr<bus::BusClient>> bus = bus::BusClient::openSystem();
  if (!bus) return false;
  const bus::BusClient::Answer answer =
      (*bus)->ask({service, rootPath, objectManagerInterface, "GetManagedObjects", {}}, limit);
  if (!answer || answer->size() != 1 || answer->front().asDictionary() == nullptr) return false;
  ObjectTree tree;
  tree.replace(*answer->front().asDictionary());
  return !tree.pathsWith(modemInterface).empty();
}

}  // namespace vespscope::sources::modemmanager
