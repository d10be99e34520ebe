#include "support/Child.h"

#include <fcntl.h>
#include <sys/ioctl.h>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>
#include <cstdlib>
#include <stdexcept>
#include <thread>

namespace vespscope::test {
namespace {

using Clock = std::chrono::steady_clock;

// In the child, between fork and exec.
void takeDescriptors(const ChildWish& wish) {
  // Out of the way of 0, 1 and 2 first.
  std::array<int, 3> copies{};
  for (std::size_t index = 0; index < copies.size(); ++index) {
    copies[index] = wish.descriptors[index] < 0 ? -1 : ::fcntl(wish.descriptors[index], F_DUPFD_CLOEXEC, 3);
  }
  for (std::size_t index = 0; index < copies.size(); ++index) {
    copies[index] < 0 ? ::close(static_cast<int>(index)) : ::dup2(copies[index], static_cast<int>(index));
  }
  ::close_range(3, ~0U, CLOSE_RANGE_CLOEXEC);
  if (wish.controllingTerminal) ::ioctl(0, TIOCSCTTY, 0);
}

}  // namespace

Child::Child(const ChildWish& wish) {
  std::string name = wish.program.string();
  std::vector<std::string> words = wish.arguments;
  std::vector<char*> pointers = {name.data()};
  for (std::string& word : words) pointers.push_back(word.data());
  pointers.push_back(nullptr);
  process_ = ::fork();
  if (process_ < 0) throw std::runtime_error("no process is left");
  if (process_ > 0) return;
  ::prctl(PR_SET_PDEATHSIG, SIGKILL);
  ::setsid();
  takeDescriptors(wish);
  if (!wish.folder.empty() && ::chdir(wish.folder.c_str()) != 0) ::_exit(127);
  const rlimit noCore{0, 0};
  ::setrlimit(RLIMIT_CORE, &noCore);
  for (const auto& [resource, value] : wish.limits) {
    const rlimit limit{value, value};
    ::setrlimit(resource, &limit);
  }
  for (const auto& [key, value] : wish.variables) ::setenv(key.c_str(), value.c_str(), 1);
  // Whatever started this process may have them ignored.
  for (const int number : {SIGHUP, SIGINT, SIGPIPE, SIGTERM}) ::signal(number, SIG_DFL);
  ::execv(name.c_str(), pointers.data());
  ::_exit(127);
}

Child::~Child() {
  if (end_) return;
  ::kill(process_, SIGKILL);
  ::waitpid(process_, nullptr, 0);
}

void Child::signal(int number) const {
  if (!end_) ::kill(process_, number);
}

std::optional<ProcessEnd> Child::waitForEnd(std::chrono::milliseconds limit) {
  const Clock::time_point deadline = Clock::now() + limit;
  while (!end_) {
    int status = 0;
    if (::waitpid(process_, &status, WNOHANG) == process_) {
      end_ = WIFSIGNALED(status) ? ProcessEnd{true, WTERMSIG(status)} : ProcessEnd{false, WEXITSTATUS(status)};
    } else if (Clock::now() >= deadline) {
      break;
    } else {
      std::this_thread::sleep_for(std::chrono::milliseconds(2));
    }
  }
  return end_;
}

std::string wordsOf(const ProcessEnd& end) {
  return (end.signalled ? "signal " : "status ") + std::to_string(end.number);
}

}  // namespace vespscope::test
