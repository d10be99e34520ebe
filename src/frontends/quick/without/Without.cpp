// Stands in for the phone interface in builds without its toolkit.
#include "frontends/quick/QuickFrontend.h"
#include "platform/log/Log.h"

namespace vespscope::quick {

std::optional<Obstacle> obstacle() {
  return Obstacle{
      "this build has no phone interface: Qt 6.4 or later with Qt Quick was not found when it was configured (Debian: "
      "qt6-declarative-dev)"};
}

std::unique_ptr<application::Frontend> makeFrontend(RefusalHandler /*refused*/) {
  log::fatal("the phone interface was asked for, but " + obstacle()->reason);
}

}  // namespace vespscope::quick
