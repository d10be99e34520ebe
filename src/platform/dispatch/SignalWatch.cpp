#include "platform/dispatch/SignalWatch.h"

#include <signal.h>

#include <atomic>
#include <utility>

#include "platform/log/Log.h"

namespace vespscope::dispatch {
namespace {

std::atomic<const WakeDescriptor*> watched = nullptr;  // the one that the handler wakes

extern "C" void noteSignal(int /*signal*/) {
  if (const WakeDescriptor* receiver = watched) receiver->wake();
}

void handle(int signal, void (*handler)(int)) {
  struct sigaction action {};
  action.sa_handler = handler;
  // The default comes back with the first signal.
  action.sa_flags = SA_RESTART | static_cast<int>(SA_RESETHAND);
  ::sigaction(signal, &action, nullptr);
}

}  // namespace

SignalWatch::SignalWatch(MainLoop& loop, std::function<void()> action) : loop_(loop) {
  if (const WakeDescriptor* none = nullptr; !watched.compare_exchange_strong(none, &received_)) {
    log::fatal("signals are watched already");
  }
  loop_.watch(received_.descriptor(), [this, action = std::move(action)] {
    if (received_.clear()) action();
  });
  handle(SIGINT, noteSignal);
  handle(SIGTERM, noteSignal);
}

SignalWatch::~SignalWatch() {
  handle(SIGINT, SIG_DFL);
  handle(SIGTERM, SIG_DFL);
  loop_.unwatch(received_.descriptor());
  watched = nullptr;
}

}  // namespace vespscope::dispatch
