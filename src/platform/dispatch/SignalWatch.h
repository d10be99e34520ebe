// Turns signals into tasks on a program's main loop.
#pragma once

#include <signal.h>

#include <array>
#include <functional>
#include <vector>

#include "platform/dispatch/MainLoop.h"

namespace vespscope::dispatch {

// While it lives, signals call an action from `loop`. A signal that comes before the loop runs is not lost. There is at
// most one watch at a time.
class SignalWatch {
 public:
  struct Signals {
    // The first of each calls the action; the second one ends the process at once, so that a loop that does not run can
    // still be left.
    std::vector<int> once = {SIGINT, SIGTERM};
    // Each of them calls the action.
    std::vector<int> always = {};
    // Called within the signal handler as well, with the signal; may be null. It may do only what a handler may.
    void (*immediately)(int signal) = nullptr;
  };
  using Action = std::function<void(int signal)>;

  SignalWatch(MainLoop& loop, const Signals& watched, Action action);
  // The first SIGINT and the first SIGTERM call `action`.
  SignalWatch(MainLoop& loop, const std::function<void()>& action);
  SignalWatch(const SignalWatch&) = delete;
  SignalWatch& operator=(const SignalWatch&) = delete;
  // The signals have the effect again that they had before.
  ~SignalWatch();

  // Gives one signal for once the effect that it had before this object: a stop signal stops the process until it is
  // continued.
  void deliverAsBefore(int signal);

 private:
  struct Handled {
    int signal;
    struct sigaction before;
  };

  void handle(int signal, int flags);
  void readSignals();

  MainLoop& loop_;
  Action action_;
  std::array<int, 2> ends_{-1, -1};  // of the pipe that the handler writes signals into
  std::vector<Handled> handled_;
};

}  // namespace vespscope::dispatch
