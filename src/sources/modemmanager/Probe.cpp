#include "sources/modemmanager/Probe.h"

#include <poll.h>

#include <algorithm>
#include <memory>
#include <optional>

#include "rhoxlink/bus/BusClient.h"
#include "sources/modemmanager/Names.h"
#include "sources/modemmanager/ObjectTree.h"

namespace vespscope::sources::modemmanager {

bool modemManagerHasModem(std::chrono::milliseconds limit) {
  using Clock = std::chrono::steady_clock;
  const Clock::time_point until = Clock::now() + limit;
  std::optional<bool> found;
  Result<std::unique_ptr<bus::BusClient>> bus = bus::BusClient::openSystem();
  if (!bus) return false;
  (*bus)->call({service, rootPath, objectManagerInterface, "GetManagedObjects", {}}, limit,
               [&found](const bus::BusClient::Answer& answer) {
                 ObjectTree tree;
                 if (answer && answer->size() == 1 && answer->front().asDictionary() != nullptr) {
                   tree.replace(*answer->front().asDictionary());
                 }
                 found = !tree.pathsWith(modemInterface).empty();
               });
  while ((*bus)->process() && !found) {
    const auto rest = std::chrono::duration_cast<std::chrono::milliseconds>(until - Clock::now());
    if (rest.count() <= 0) break;
    const bus::Wait wait = (*bus)->wait();
    pollfd ready{wait.descriptor, wait.events, 0};
    ::poll(&ready, 1, static_cast<int>(rest.count()));
  }
  return found.value_or(false);
}

}  // namespace vespscope::sources::modemmanager
