#include "frontends/quick/entry/PhoneInterface.h"

#include <utility>

#include "frontends/quick/entry/DisplayNames.h"

namespace vespscope::quick {
namespace {

// Loaded once; a failure is not retried.
const Result<const Module*>& module() {
  static const Result<const Module*> loaded = loadModule(modulePath());
  return loaded;
}

}  // namespace

std::optional<Obstacle> obstacle() {
  if constexpr (VESPSCOPE_HAS_QUICK == 0) {
    return Obstacle{
        "this build has no phone interface: Qt 6.4 or later with Qt Quick was not found when it was configured "
        "(Debian: qt6-declarative-dev)"};
  }
  if (platformsToTry().empty()) return Obstacle{noDisplayNamed};
  if (!module())
    return Obstacle{.reason = "the phone interface is not there: " + module().reason(), .unexpected = true};
  return (*module())->obstacle();
}

std::unique_ptr<application::Frontend> makeFrontend(RefusalHandler refused) {
  return (*module())->makeFrontend(std::move(refused));
}

}  // namespace vespscope::quick
