#include "support/Process.h"

#include <fcntl.h>
#include <poll.h>
#include <signal.h>
#include <sys/prctl.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstdlib>
#include <stdexcept>

namespace vespscope::test {
namespace {

using Clock = std::chrono::steady_clock;

std::array<int, 2> makePipe() {
  std::array<int, 2> ends{};
  if (::pipe2(ends.data(), O_CLOEXEC) != 0) throw std::runtime_error("no pipe is left");
  return ends;
}

}  // namespace

Process::Process(const std::filesystem::path& program, const std::vector<std::string>& arguments,
                 const std::map<std::string, std::string>& variables, const std::filesystem::path& input) {
  const std::array<int, 2> output = makePipe();
  const std::array<int, 2> errors = makePipe();
  std::string name = program.string();
  std::vector<std::string> words = arguments;
  std::vector<char*> pointers = {name.data()};
  for (std::string& word : words) pointers.push_back(word.data());
  pointers.push_back(nullptr);

  process_ = ::fork();
  if (process_ < 0) throw std::runtime_error("no process is left");
  if (process_ == 0) {
    ::prctl(PR_SET_PDEATHSIG, SIGKILL);
    const rlimit noCore{0, 0};
    ::setrlimit(RLIMIT_CORE, &noCore);
    ::setsid();  // without the user's terminal, which the program could take control of
    ::dup2(::open(input.c_str(), O_RDONLY), STDIN_FILENO);
    ::dup2(output[1], STDOUT_FILENO);
    ::dup2(errors[1], STDERR_FILENO);
    for (const auto& [key, value] : variables) ::setenv(key.c_str(), value.c_str(), 1);
    ::execv(name.c_str(), pointers.data());
    ::_exit(127);
  }
  ::close(output[1]);
  ::close(errors[1]);
  output_.descriptor = output[0];
  errors_.descriptor = errors[0];
}

Process::~Process() {
  if (!end_) {
    ::kill(process_, SIGKILL);
    ::waitpid(process_, nullptr, 0);
  }
  close(output_);
  close(errors_);
}

void Process::close(Pipe& pipe) {
  if (pipe.descriptor >= 0) ::close(pipe.descriptor);
  pipe.descriptor = -1;
}

void Process::readInto(Pipe& pipe) {
  std::array<char, 4096> buffer;
  const ssize_t count = ::read(pipe.descriptor, buffer.data(), buffer.size());
  if (count > 0) {
    pipe.text.append(buffer.data(), static_cast<std::size_t>(count));
  } else if (count == 0 || errno != EINTR) {
    close(pipe);
  }
}

bool Process::read(std::chrono::milliseconds limit) {
  std::array<pollfd, 2> entries = {{{output_.descriptor, POLLIN, 0}, {errors_.descriptor, POLLIN, 0}}};
  if (output_.descriptor < 0 && errors_.descriptor < 0) return false;
  ::poll(entries.data(), entries.size(), static_cast<int>(limit.count()));
  if (entries[0].revents != 0) readInto(output_);
  if (entries[1].revents != 0) readInto(errors_);
  return true;
}

bool Process::waitFor(const Pipe& pipe, const std::string& text, std::size_t from) {
  const Clock::time_point deadline = Clock::now() + processPatience;
  while (pipe.text.find(text, from) == std::string::npos) {
    if (pipe.descriptor < 0 || Clock::now() > deadline) return false;
    read(std::chrono::milliseconds(100));
  }
  return true;
}

bool Process::waitForOutput(const std::string& text, std::size_t from) { return waitFor(output_, text, from); }
bool Process::waitForErrors(const std::string& text) { return waitFor(errors_, text, 0); }

void Process::readFor(std::chrono::milliseconds duration) {
  const Clock::time_point end = Clock::now() + duration;
  while (Clock::now() < end && read(std::chrono::milliseconds(10))) {
  }
}

std::optional<ProcessEnd> Process::wait() {
  const Clock::time_point deadline = Clock::now() + processPatience;
  while (!end_ && Clock::now() < deadline) {
    // A closed output does not mean that the process has ended.
    if (!read(std::chrono::milliseconds(20))) ::poll(nullptr, 0, 20);
    int status = 0;
    if (::waitpid(process_, &status, WNOHANG) != process_) continue;
    end_ = WIFSIGNALED(status) ? ProcessEnd{true, WTERMSIG(status)} : ProcessEnd{false, WEXITSTATUS(status)};
    while (read(std::chrono::milliseconds(20)) && Clock::now() < deadline) {
    }
  }
  return end_;
}

void Process::signal(int number) const {
  if (!end_) ::kill(process_, number);
}

void Process::closeOutput() { close(output_); }

}  // namespace vespscope::test
