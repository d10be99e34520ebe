#include "tools/vespctl/EndSignals.h"

#include <signal.h>
#include <unistd.h>

#include <array>
#include <atomic>
#include <cstdlib>

namespace vespscope::tools {
namespace {

constexpr std::array<int, 3> endSignals = {SIGINT, SIGTERM, SIGHUP};

std::atomic<sources::EventStream*> interruptedStream = nullptr;
std::atomic<int> receivedNumber = 0;

void interruptStream(int number) {
  receivedNumber = number;
  if (sources::EventStream* stream = interruptedStream) stream->interrupt();
}

// Sets the handler of each signal that is not ignored.
void handleWith(void (*handler)(int)) {
  for (const int number : endSignals) {
    struct sigaction present {};
    if (::sigaction(number, nullptr, &present) != 0 || present.sa_handler == SIG_IGN) continue;
    struct sigaction wanted {};
    wanted.sa_handler = handler;
    ::sigaction(number, &wanted, nullptr);
  }
}

}  // namespace

EndSignals::EndSignals(sources::EventStream& stream) {
  interruptedStream = &stream;
  handleWith(interruptStream);
}

EndSignals::~EndSignals() {
  handleWith(SIG_DFL);
  interruptedStream = nullptr;
}

bool EndSignals::received() const { return receivedNumber != 0; }

void EndSignals::endProcess() const {
  handleWith(SIG_DFL);
  ::raise(receivedNumber);
  std::_Exit(EXIT_FAILURE);  // the signal is blocked
}

}  // namespace vespscope::tools
