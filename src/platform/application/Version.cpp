#include "platform/application/System.h"

namespace vespscope::application {
namespace {

Version& platformVersion() {
  static Version version{13, 0, 0};
  return version;
}

}  // namespace

bool isPlatformAtLeast(Version version) { return platformVersion() >= version; }
void setPlatformVersion(Version version) { platformVersion() = version; }

}  // namespace vespscope::application
