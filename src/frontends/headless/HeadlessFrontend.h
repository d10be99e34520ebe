// The frontend without an interface: runs the program, which writes its log lines, until a signal ends it.
#pragma once

#include "platform/application/Application.h"
#include "platform/dispatch/SignalWatch.h"

namespace vespscope {

class HeadlessFrontend : public application::Frontend {
 public:
  // From here on SIGINT and SIGTERM end the program normally.
  HeadlessFrontend();
  // Returns 0 after a signal.
  int run(application::Application& application) override;

 private:
  dispatch::SignalWatch signals_;
};

}  // namespace vespscope
