#include "platform/dispatch/SignalWatch.h"

#include <fcntl.h>
#include <unistd.h>

#include <atomic>
#include <cerrno>
#include <cstdint>
#include <utility>

#include "platform/log/Log.h"

namespace vespscope::dispatch {
namespace {

std::atomic<int> pipeForHandlers = -1;
std::atomic<void (*)(int)> alsoInHandlers = nullptr;
std::atomic<bool> endRequested = false;

// Any thread may receive a signal, so the handler writes into a pipe and no thread has to block signals.
extern "C" void passOn(int signal) {
  const int before = errno;
  const auto byte = static_cast<std::uint8_t>(signal);
  // A full pipe holds enough signals to act on.
  [[maybe_unused]] const ssize_t ignored = ::write(pipeForHandlers, &byte, 1);
  if (const auto also = alsoInHandlers.load()) also(signal);
  errno = before;
}

extern "C" void requestEnd(int signal) {
  endRequested = true;
  passOn(signal);
}

}  // namespace

bool endWasRequested() { return endRequested; }

SignalWatch::SignalWatch(MainLoop& loop, const Signals& watched, Action action)
    : loop_(loop), action_(std::move(action)) {
  if (::pipe2(ends_.data(), O_CLOEXEC | O_NONBLOCK) != 0) log::fatal("cannot create a pipe for signals");
  if (int none = -1; !pipeForHandlers.compare_exchange_strong(none, ends_[1])) {
    log::fatal("signals are watched already");
  }
  alsoInHandlers = watched.immediately;
  endRequested = false;
  loop_.watch(ends_[0], [this] { readSignals(); });
  for (const int signal : watched.always) handle(signal, passOn, SA_RESTART);
  for (const int signal : watched.once) {
    handle(signal, requestEnd, SA_RESTART | static_cast<int>(SA_RESETHAND));
  }
}

SignalWatch::SignalWatch(MainLoop& loop, const std::function<void()>& action)
    : SignalWatch(loop, Signals(), [action](int /*signal*/) { action(); }) {}

SignalWatch::~SignalWatch() {
  for (const Handled& handled : handled_) ::sigaction(handled.signal, &handled.before, nullptr);
  loop_.unwatch(ends_[0]);
  alsoInHandlers = nullptr;
  endRequested = false;
  pipeForHandlers = -1;
  for (const int end : ends_) ::close(end);
}

void SignalWatch::handle(int signal, void (*handler)(int), int flags) {
  struct sigaction action {};
  action.sa_handler = handler;
  action.sa_flags = flags;
  Handled& added = handled_.emplace_back(Handled{signal, {}});
  ::sigaction(signal, &action, &added.before);
}

void SignalWatch::readSignals() {
  std::uint8_t byte = 0;
  while (true) {
    const ssize_t count = ::read(ends_[0], &byte, 1);
    if (count < 0 && errno == EINTR) continue;
    if (count != 1) return;
    action_(byte);
  }
}

void SignalWatch::deliverAsBefore(int signal) {
  for (const Handled& handled : handled_) {
    if (handled.signal != signal) continue;
    struct sigaction ours {};
    ::sigaction(signal, &handled.before, &ours);
    ::raise(signal);  // a stop signal returns from here when the process is continued
    ::sigaction(signal, &ours, nullptr);
  }
}

}  // namespace vespscope::dispatch
