#include "frontends/headless/HeadlessFrontend.h"

#include "platform/dispatch/MainLoop.h"
#include "platform/log/Log.h"

namespace vespscope {

HeadlessFrontend::HeadlessFrontend()
    : signals_(dispatch::MainLoop::main(), [] { dispatch::MainLoop::main().stop(0); }) {}

int HeadlessFrontend::run(application::Application& /*application*/) {
  const int status = dispatch::MainLoop::main().run();
  log::flush();
  return status;
}

}  // namespace vespscope
