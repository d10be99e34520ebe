#include "rhoxlink/SshProcess.h"

#include <fcntl.h>
#include <poll.h>
#include <signal.h>
#include <sys/socket.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <chrono>
#include <cstring>
#include <string_view>
#include <utility>
#include <vector>

#include <spawn.h>

#include "values/Text.h"

extern "C" {
#include <sys/pidfd.h>  // the system's header lacks extern "C"
}

namespace rhox::client {
namespace {

using namespace std::chrono_literals;
using vespscope::Failure;
using vespscope::Result;

constexpr std::size_t keptErrors = 2048;  // bytes
constexpr auto endPatience = 2s;          // for an ssh that has closed its output, or was sent SIGTERM
constexpr int notFound = 127;             // the remote shell's exit status when there is no such program

// No terminal, no prompts, no shared connection; a dead connection is noticed after 15 s.
std::vector<std::string> commandTo(const std::string& destination) {
  return {"ssh",
          "-x",
          "-T",
          "-e",
          "none",
          "-o",
          "BatchMode=yes",
          "-o",
          "LogLevel=ERROR",
          "-o",
          "ControlMaster=no",
          "-o",
          "ClearAllForwardings=yes",
          "-o",
          "ConnectTimeout=10",
          "-o",
          "ServerAliveInterval=5",
          "-o",
          "ServerAliveCountMax=3",
          "--",
          destination,
          "rhoxd",
          "--stdio"};
}

struct SpawnActions {
  SpawnActions() { ::posix_spawn_file_actions_init(&actions); }
  SpawnActions(const SpawnActions&) = delete;
  SpawnActions& operator=(const SpawnActions&) = delete;
  ~SpawnActions() { ::posix_spawn_file_actions_destroy(&actions); }
  posix_spawn_file_actions_t actions{};
};

struct SpawnAttributes {
  // ssh gets its own process group, so that the terminal's Ctrl-C reaches only the viewer, and no signal is blocked in
  // it.
  SpawnAttributes() {
    ::posix_spawnattr_init(&attributes);
    sigset_t none;
    sigset_t pipe;
    ::sigemptyset(&none);
    ::sigemptyset(&pipe);
    ::sigaddset(&pipe, SIGPIPE);
    ::posix_spawnattr_setsigmask(&attributes, &none);
    ::posix_spawnattr_setsigdefault(&attributes, &pipe);
    ::posix_spawnattr_setpgroup(&attributes, 0);
    ::posix_spawnattr_setflags(&attributes, POSIX_SPAWN_SETSIGMASK | POSIX_SPAWN_SETSIGDEF | POSIX_SPAWN_SETPGROUP);
  }
  SpawnAttributes(const SpawnAttributes&) = delete;
  SpawnAttributes& operator=(const SpawnAttributes&) = delete;
  ~SpawnAttributes() { ::posix_spawnattr_destroy(&attributes); }
  posix_spawnattr_t attributes{};
};

// Starts the program; returns its process number, or the negative error number.
pid_t spawn(std::vector<std::string> words, int inputOutput, int errors) {
  std::vector<char*> pointers;
  pointers.reserve(words.size() + 1);
  for (std::string& word : words) pointers.push_back(word.data());
  pointers.push_back(nullptr);
  SpawnActions actions;
  const SpawnAttributes attributes;
  ::posix_spawn_file_actions_adddup2(&actions.actions, inputOutput, STDIN_FILENO);
  ::posix_spawn_file_actions_adddup2(&actions.actions, inputOutput, STDOUT_FILENO);
  ::posix_spawn_file_actions_adddup2(&actions.actions, errors, STDERR_FILENO);
  pid_t process = -1;
  const int error =
      ::posix_spawnp(&process, pointers.front(), &actions.actions, &attributes.attributes, pointers.data(), ::environ);
  return error == 0 ? process : -error;
}

std::string_view lastLineOf(std::string_view text) {
  while (!text.empty() && (text.back() == '\n' || text.back() == '\r')) text.remove_suffix(1);
  const std::size_t begin = text.rfind('\n');
  return begin == std::string_view::npos ? text : text.substr(begin + 1);
}

}  // namespace

Result<std::shared_ptr<SshProcess>> SshProcess::start(const std::string& destination) {
  std::array<int, 2> ends{};
  std::array<int, 2> errors{};
  if (::socketpair(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0, ends.data()) != 0) {
    return Failure{std::string("cannot create a socket pair: ") + std::strerror(errno)};
  }
  if (::pipe2(errors.data(), O_CLOEXEC) != 0) {
    const int error = errno;
    for (const int end : ends) ::close(end);
    return Failure{std::string("cannot create a pipe: ") + std::strerror(error)};
  }
  const pid_t process = spawn(commandTo(destination), ends[1], errors[1]);
  ::close(ends[1]);
  ::close(errors[1]);
  const int processDescriptor = process > 0 ? ::pidfd_open(process, 0) : -1;
  if (processDescriptor < 0) {
    const int error = process > 0 ? errno : -process;
    if (process > 0) {
      ::kill(process, SIGKILL);
      ::waitpid(process, nullptr, 0);
    }
    ::close(ends[0]);
    ::close(errors[0]);
    return Failure{std::string("ssh cannot be started: ") + std::strerror(error)};
  }
  for (const int descriptor : {ends[0], errors[0]}) ::fcntl(descriptor, F_SETFL, O_NONBLOCK);
  return std::shared_ptr<SshProcess>(new SshProcess(destination, process, processDescriptor, ends[0], errors[0]));
}

SshProcess::SshProcess(std::string destination, pid_t process, int processDescriptor, int descriptor, int errors)
    : destination_(std::move(destination)),
      process_(process),
      processDescriptor_(processDescriptor),
      descriptor_(descriptor),
      errors_(errors),
      thread_([this] { watch(); }) {}

SshProcess::~SshProcess() {
  if (descriptor_ >= 0) ::close(descriptor_);
  {
    std::unique_lock lock(mutex_);
    const auto ended = [this] { return status_.has_value(); };
    // The process is not reaped before status_ is set, so the number is still its own.
    if (!ended()) ::kill(process_, SIGTERM);
    if (!changed_.wait_for(lock, endPatience, ended)) ::kill(process_, SIGKILL);
  }
  thread_.join();
  ::close(processDescriptor_);
  ::close(errors_);
}

int SshProcess::takeDescriptor() { return std::exchange(descriptor_, -1); }

// Reads its error output until the process ends, so that ssh never blocks on it, and keeps the last part. Other
// processes may still hold the pipe open.
void SshProcess::watch() {
  bool open = true;
  while (true) {
    std::array<pollfd, 2> ready{{{processDescriptor_, POLLIN, 0}, {open ? errors_ : -1, POLLIN, 0}}};
    if (::poll(ready.data(), ready.size(), -1) < 0 && errno != EINTR) break;
    if (ready[1].revents != 0) readErrors();
    open = open && (ready[1].revents & (POLLHUP | POLLERR)) == 0;
    if (ready[0].revents != 0) break;
  }
  readErrors();
  const std::lock_guard lock(mutex_);
  int status = 0;
  ::waitpid(process_, &status, 0);
  status_ = status;
  changed_.notify_all();
}

void SshProcess::readErrors() {
  std::array<char, 1024> buffer;
  ssize_t count = 0;
  while ((count = ::read(errors_, buffer.data(), buffer.size())) > 0) {
    lastErrors_.append(buffer.data(), static_cast<std::size_t>(count));
    if (lastErrors_.size() > keptErrors) lastErrors_.erase(0, lastErrors_.size() - keptErrors);
  }
}

std::string SshProcess::explainEnd() {
  std::unique_lock lock(mutex_);
  const std::string to = "ssh to " + destination_;
  if (!changed_.wait_for(lock, endPatience, [this] { return status_.has_value(); })) {
    return to + " has closed the connection";
  }
  const std::string line = vespscope::printable(lastLineOf(lastErrors_));
  const int exit = WIFEXITED(*status_) ? WEXITSTATUS(*status_) : -1;
  if (exit == notFound) return to + ": rhoxd is not installed there" + (line.empty() ? "" : " (" + line + ")");
  if (!line.empty()) return to + ": " + line;
  return exit == 0 ? to + ": the manager there closed the connection"
                   : to + " ended with status " + std::to_string(exit);
}

}  // namespace rhox::client
