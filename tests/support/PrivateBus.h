// A bus daemon of the test in place of the system bus, for this process and its children.
#pragma once

#include <functional>
#include <memory>
#include <string>

#include "support/Process.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {

class PrivateBus {
 public:
  // Starts the daemon, and waits until it listens. Every user may do everything on this bus.
  PrivateBus();
  PrivateBus(const PrivateBus&) = delete;
  PrivateBus& operator=(const PrivateBus&) = delete;
  virtual ~PrivateBus();

  [[nodiscard]] std::string address() const { return "unix:path=" + (folder_ / "bus"); }

  void stop();
  void start();

 protected:
  // Starts a bus with this configuration; `makeConfiguration` receives the folder of the bus, whose socket must be
  // called "bus".
  explicit PrivateBus(const std::function<std::string(const TemporaryFolder&)>& makeConfiguration);

 private:
  TemporaryFolder folder_;
  std::unique_ptr<Process> daemon_;
};

// Sets the system bus to an address where there is none, for this process and its children.
void useNoBus();

}  // namespace vespscope::test
