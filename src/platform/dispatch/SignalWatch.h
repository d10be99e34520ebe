// Turns signals into tasks on a program's main loop.
#pragma once

#include <signal.h>

#include <array>
#include <functional>
#include <vector>

#include "platform/dispatch/MainLoop.h"

namespace vespscope::dispatch {

// While it lives, signals run an action on `loop`. A signal that arrives before the loop runs is not lost. At most one
// watch exists at a time.
class SignalWatch {
 public:
  struct Signals {
    // The first of each runs the action; the second ends the process at once, so that a user can leave a loop that
    // hangs.
    std::vector<int> once = {SIGINT, SIGTERM};
    // Each of them runs the action.
    std::vector<int> always = {};
    // Also called in the signal handler, with the signal; may be null. It must be async-signal-safe.
    void (*immediately)(int signal) = nullptr;
  };
  using Action = std::function<void(int signal)>;

  SignalWatch(MainLoop& loop, const Signals& watched, Action action);
  // The first SIGINT and the first SIGTERM run `action`.
  SignalWatch(MainLoop& loop, const std::function<void()>& action);
  SignalWatch(const SignalWatch&) = delete;
  SignalWatch& operator=(const SignalWatch&) = delete;
  // Restores the previous effect of the signals.
  ~SignalWatch();

  // Raises one signal with the effect that it had before this object: a stop signal stops the process until it is
  // continued.
  void deliverAsBefore(int signal);

 private:
  struct Handled {
    int signal;
    struct sigaction before;
  };

  void handle(int signal, void (*handler)(int), int flags);
  void readSignals();

  MainLoop& loop_;
  Action action_;
  std::array<int, 2> ends_{-1, -1};  // of the pipe that the handler writes signals into
  std::vector<Handled> handled_;
};

// Whether one of the present watch's `once` signals has come: the program is to end soon, so nobody should wait long.
[[nodiscard]] bool endWasRequested();

}  // namespace vespscope::dispatch
