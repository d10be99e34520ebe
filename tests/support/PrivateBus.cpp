#include "support/PrivateBus.h"

#include <cstdlib>
#include <stdexcept>

#include <stdlib.h>

namespace vespscope::test {
namespace {

constexpr const char* configuration = R"(<busconfig>
  <type>session</type>
  <listen>ADDRESS</listen>
  <auth>EXTERNAL</auth>
  <policy context="default">
    <allow send_destination="*" eavesdrop="true"/>
    <allow eavesdrop="true"/>
    <allow own="*"/>
  </policy>
</busconfig>
)";

void useBus(const std::string& address) {
  ::setenv("DBUS_SYSTEM_BUS_ADDRESS", address.c_str(), 1);
  ::setenv("DBUS_SESSION_BUS_ADDRESS", address.c_str(), 1);
}

}  // namespace

PrivateBus::PrivateBus()
    : PrivateBus([](const TemporaryFolder& folder) {
        std::string contents = configuration;
        return contents.replace(contents.find("ADDRESS"), std::string("ADDRESS").size(),
                                "unix:path=" + (folder / "bus"));
      }) {}

PrivateBus::PrivateBus(const std::function<std::string(const TemporaryFolder&)>& makeConfiguration) {
  folder_.write("bus.conf", makeConfiguration(folder_));
  start();
  useBus(address());
}

PrivateBus::~PrivateBus() { stop(); }

void PrivateBus::stop() { daemon_.reset(); }

void PrivateBus::start() {
  daemon_ = std::make_unique<Process>("/usr/bin/dbus-daemon",
                                      std::vector<std::string>{"--config-file=" + (folder_ / "bus.conf"), "--nofork",
                                                               "--nopidfile", "--print-address"});
  if (!daemon_->waitForOutput("unix:")) throw std::runtime_error("no bus daemon: " + daemon_->errors());
}

void useNoBus() { useBus("unix:path=/nonexistent/bus"); }

}  // namespace vespscope::test
