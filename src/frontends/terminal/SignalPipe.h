// Turns signals into bytes that the main loop can wait for, while the object lives.
#pragma once

#include <signal.h>

#include <optional>
#include <vector>

namespace vespscope::terminal {

// Signals reach any thread, so handlers write to a pipe rather than threads blocking them. One object at a time.
class SignalPipe {
 public:
  // Of each signal of `once` only the first is turned into a byte; the second one does what it did before, so that a
  // loop that is held up can still be left.
  SignalPipe(const std::vector<int>& always, const std::vector<int>& once);
  SignalPipe(const SignalPipe&) = delete;
  SignalPipe& operator=(const SignalPipe&) = delete;
  ~SignalPipe();

  // Readable when a signal has come.
  [[nodiscard]] int descriptor() const { return read_; }
  // The next signal that has come; empty when there is none.
  [[nodiscard]] std::optional<int> next();

  // Lets one signal do for once what it did before this object: a stop signal stops the process until it is continued.
  void deliverAsBefore(int signal);

 private:
  struct Handled {
    int signal;
    struct sigaction before;
  };

  void handle(int signal, int flags);

  int read_ = -1;
  int write_ = -1;
  std::vector<Handled> handled_;
};

}  // namespace vespscope::terminal
