#include "support/Tmux.h"

#include <sys/wait.h>
#include <unistd.h>

#include <array>
#include <cstdio>
#include <cstdlib>
#include <stdexcept>
#include <thread>

namespace vespscope::test {
namespace {

constexpr std::chrono::seconds patience{15};
constexpr std::chrono::milliseconds pollInterval{15};

// Runs a program and returns its standard output.
std::string outputOf(const std::vector<std::string>& command) {
  std::array<int, 2> ends{};
  if (::pipe(ends.data()) != 0) throw std::runtime_error("no pipe");
  const pid_t child = ::fork();
  if (child == 0) {
    ::dup2(ends[1], STDOUT_FILENO);
    ::close(ends[0]);
    ::close(ends[1]);
    std::vector<char*> arguments;
    for (const std::string& argument : command) arguments.push_back(const_cast<char*>(argument.c_str()));
    arguments.push_back(nullptr);
    ::execvp(arguments[0], arguments.data());
    ::_exit(127);
  }
  ::close(ends[1]);
  std::string output;
  std::array<char, 4096> buffer;
  for (ssize_t count = 0; (count = ::read(ends[0], buffer.data(), buffer.size())) > 0;) {
    output.append(buffer.data(), static_cast<std::size_t>(count));
  }
  ::close(ends[0]);
  ::waitpid(child, nullptr, 0);
  return output;
}

}  // namespace

bool Tmux::available() { return outputOf({"tmux", "-V"}).substr(0, 4) == "tmux"; }

Tmux::Tmux(int width, int height) {
  ::setenv("LC_ALL", "C.UTF-8", 1);
  ::unsetenv("TMUX");
  // The terminal outlives its shell, so that its last screen can be read.
  tmux({"-f", "/dev/null", "new-session", "-d", "-x", std::to_string(width), "-y", std::to_string(height),
        "env -i PATH=/usr/local/bin:/usr/bin:/bin TERM=tmux-256color LC_ALL=C.UTF-8 TZ=UTC PS1='$ ' HOME=" +
            folder().string() + " bash --norc --noprofile -i"});
  tmux({"set-option", "-g", "history-limit", "0"});
  tmux({"set-option", "-g", "status", "off"});
  tmux({"set-option", "-g", "escape-time", "0"});
  tmux({"set-option", "-g", "window-size", "manual"});
  resize(width, height);
  if (!shows("$")) throw std::runtime_error("no shell in tmux");
}

Tmux::~Tmux() {
  if (!ended_) tmux({"kill-server"});
}

std::string Tmux::tmux(std::vector<std::string> arguments) const {
  std::vector<std::string> command{"tmux", "-u", "-S", folder_ / "socket"};
  command.insert(command.end(), std::make_move_iterator(arguments.begin()), std::make_move_iterator(arguments.end()));
  return outputOf(command);
}

void Tmux::command(const std::string& line) {
  tmux({"send-keys", "-l", line});
  press({"Enter"});
}

void Tmux::press(const std::vector<std::string>& keys) {
  std::vector<std::string> arguments{"send-keys"};
  arguments.insert(arguments.end(), keys.begin(), keys.end());
  tmux(std::move(arguments));
}

void Tmux::send(const std::string& bytes) {
  std::vector<std::string> arguments{"send-keys", "-H"};
  for (const char byte : bytes) {
    std::array<char, 4> text{};
    std::snprintf(text.data(), text.size(), "%02x", static_cast<unsigned>(static_cast<unsigned char>(byte)));
    arguments.emplace_back(text.data());
  }
  tmux(std::move(arguments));
}

void Tmux::resize(int width, int height) {
  tmux({"resize-window", "-x", std::to_string(width), "-y", std::to_string(height)});
}

void Tmux::hangUp() {
  tmux({"kill-server"});
  ended_ = true;
}

std::string Tmux::screen(bool looks) const {
  return looks ? tmux({"capture-pane", "-p", "-e"}) : tmux({"capture-pane", "-p"});
}

::testing::AssertionResult Tmux::shows(const std::string& text) const {
  const auto result = becomes([&text](const std::string& screen) { return screen.find(text) != std::string::npos; });
  return result ? result : ::testing::AssertionFailure() << "no \"" << text << "\" " << result.message();
}

::testing::AssertionResult Tmux::becomes(const std::function<bool(const std::string&)>& wanted) const {
  const auto deadline = std::chrono::steady_clock::now() + patience;
  while (true) {
    const std::string now = screen();
    if (wanted(now)) return ::testing::AssertionSuccess();
    if (std::chrono::steady_clock::now() > deadline) return ::testing::AssertionFailure() << "on this screen:\n" << now;
    std::this_thread::sleep_for(pollInterval);
  }
}

}  // namespace vespscope::test
