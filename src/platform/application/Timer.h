// A repeating timer on the main loop that sends an operation to a target.
#pragma once

#include <chrono>
#include <memory>
#include <utility>

#include "platform/dispatch/MainLoop.h"

namespace vespscope::application {

// Calls `action` of `target` every `interval`, first after one interval. The main loop keeps the target alive until
// the timer is cancelled there.
template <class Target>
dispatch::MainLoop::TimerIdentifier scheduleTimer(std::chrono::milliseconds interval, std::shared_ptr<Target> target,
                                                  void (Target::*action)()) {
  return dispatch::MainLoop::main().scheduleRepeating(interval,
                                                      [target = std::move(target), action] { (*target.*action)(); });
}

}  // namespace vespscope::application
