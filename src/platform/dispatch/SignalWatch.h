// Turns the signals that ask a program to end into a task on its main loop.
#pragma once

#include <functional>

#include "platform/dispatch/MainLoop.h"
#include "platform/dispatch/WakeDescriptor.h"

namespace vespscope::dispatch {

// While it lives, the first SIGINT or SIGTERM calls `action` from `loop`; the second one ends the process at once, so
// that a loop that is held up can still be left. A signal that comes before the loop runs is not lost. There is at most
// one watch at a time.
class SignalWatch {
 public:
  SignalWatch(MainLoop& loop, std::function<void()> action);
  SignalWatch(const SignalWatch&) = delete;
  SignalWatch& operator=(const SignalWatch&) = delete;
  ~SignalWatch();

 private:
  MainLoop& loop_;
  WakeDescriptor received_;
};

}  // namespace vespscope::dispatch
