#include "platform/dispatch/SignalWatch.h"

#include <signal.h>
#include <sys/eventfd.h>
#include <unistd.h>

#include <atomic>
#include <cerrno>
#include <cstdint>
#include <utility>

#include "platform/log/Log.h"

namespace vespscope::dispatch {
namespace {

std::atomic<int> watched = -1;  // the descriptor that the handler writes to

extern "C" void noteSignal(int /*signal*/) {
  const int saved = errno;
  const std::uint64_t one = 1;
  [[maybe_unused]] const ssize_t ignored = ::write(watched, &one, sizeof one);  // a handler can tell nobody
  errno = saved;
}

void handle(int signal, void (*handler)(int)) {
  struct sigaction action {};
  action.sa_handler = handler;
  // The default comes back with the first signal.
  action.sa_flags = SA_RESTART | static_cast<int>(SA_RESETHAND);
  ::sigaction(signal, &action, nullptr);
}

}  // namespace

SignalWatch::SignalWatch(MainLoop& loop, std::function<void()> action)
    : loop_(loop), received_(::eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK)) {
  if (received_ < 0) log::fatal("no descriptor is left for a signal watch");
  if (int none = -1; !watched.compare_exchange_strong(none, received_)) log::fatal("signals are watched already");
  loop_.watch(received_, [received = received_, action = std::move(action)] {
    std::uint64_t count = 0;
    if (::read(received, &count, sizeof count) > 0) action();
  });
  handle(SIGINT, noteSignal);
  handle(SIGTERM, noteSignal);
}

SignalWatch::~SignalWatch() {
  handle(SIGINT, SIG_DFL);
  handle(SIGTERM, SIG_DFL);
  loop_.unwatch(received_);
  watched = -1;
  ::close(received_);
}

}  // namespace vespscope::dispatch
