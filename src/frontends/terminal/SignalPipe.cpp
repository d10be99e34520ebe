#include "frontends/terminal/SignalPipe.h"

#include <fcntl.h>
#include <unistd.h>

#include <array>
#include <atomic>
#include <cerrno>
#include <cstdint>

#include "platform/log/Log.h"

namespace vespscope::terminal {
namespace {

std::atomic<int> pipeForHandlers = -1;

extern "C" void passOn(int signal) {
  const int before = errno;
  const auto byte = static_cast<std::uint8_t>(signal);
  // A full pipe holds enough signals to act on.
  [[maybe_unused]] const ssize_t ignored = ::write(pipeForHandlers, &byte, 1);
  errno = before;
}

}  // namespace

SignalPipe::SignalPipe(const std::vector<int>& always, const std::vector<int>& once) {
  std::array<int, 2> ends{};
  if (::pipe2(ends.data(), O_CLOEXEC | O_NONBLOCK) != 0) log::fatal("no pipe for signals");
  read_ = ends[0];
  write_ = ends[1];
  pipeForHandlers = write_;
  for (const int signal : always) handle(signal, SA_RESTART);
  for (const int signal : once) handle(signal, SA_RESTART | static_cast<int>(SA_RESETHAND));
}

SignalPipe::~SignalPipe() {
  for (const Handled& handled : handled_) ::sigaction(handled.signal, &handled.before, nullptr);
  pipeForHandlers = -1;
  ::close(write_);
  ::close(read_);
}

void SignalPipe::handle(int signal, int flags) {
  struct sigaction action {};
  action.sa_handler = passOn;
  action.sa_flags = flags;
  Handled& added = handled_.emplace_back(Handled{signal, {}});
  ::sigaction(signal, &action, &added.before);
}

std::optional<int> SignalPipe::next() {
  std::uint8_t byte = 0;
  while (true) {
    const ssize_t count = ::read(read_, &byte, 1);
    if (count == 1) return byte;
    if (count < 0 && errno == EINTR) continue;
    return std::nullopt;
  }
}

void SignalPipe::deliverAsBefore(int signal) {
  for (const Handled& handled : handled_) {
    if (handled.signal != signal) continue;
    struct sigaction ours {};
    ::sigaction(signal, &handled.before, &ours);
    ::raise(signal);  // a stop signal returns from here when the process is continued
    ::sigaction(signal, &ours, nullptr);
  }
}

}  // namespace vespscope::terminal
