// A bus daemon of the test's own in the place of the system bus, for this process and those that it starts.
#pragma once

#include <functional>
#include <memory>
#include <string>

#include "support/Process.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {

class PrivateBus {
 public:
  // Starts the daemon, and waits until it listens. Everybody may do everything there.
  PrivateBus();
  PrivateBus(const PrivateBus&) = delete;
  PrivateBus& operator=(const PrivateBus&) = delete;
  virtual ~PrivateBus();

  [[nodiscard]] std::string address() const { return "unix:path=" + (folder_ / "bus"); }

  void stop();
  void start();

 protected:
  // A bus that is configured so; `makeConfiguration` is given the folder that the bus has, where "bus" is to be its
  // socket.
  explicit PrivateBus(const std::function<std::string(const TemporaryFolder&)>& makeConfiguration);

 private:
  TemporaryFolder folder_;
  std::unique_ptr<Process> daemon_;
};

// Makes the system bus one that is not there, for this process and those that it starts.
void useNoBus();

}  // namespace vespscope::test
