#include "support/Pty.h"

#include <fcntl.h>
#include <poll.h>
#include <signal.h>
#include <sys/ioctl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cstdlib>
#include <stdexcept>
#include <thread>

#include <pty.h>
#include <utmp.h>

namespace vespscope::test {

Pty::Pty(const std::vector<std::string>& command) {
  winsize size{.ws_row = 24, .ws_col = 80, .ws_xpixel = 0, .ws_ypixel = 0};
  if (::openpty(&master_, &slave_, nullptr, nullptr, &size) != 0) throw std::runtime_error("no terminal");
  std::vector<char*> arguments;
  for (const std::string& argument : command) arguments.push_back(const_cast<char*>(argument.c_str()));
  arguments.push_back(nullptr);
  program_ = ::fork();
  if (program_ == 0) {
    ::close(master_);
    ::login_tty(slave_);
    ::setenv("TERM", "xterm-256color", 1);
    ::setenv("LC_ALL", "C.UTF-8", 1);
    ::execv(arguments[0], arguments.data());
    ::_exit(127);
  }
}

Pty::~Pty() {
  if (program_ > 0) {
    ::kill(program_, SIGKILL);
    ::waitpid(program_, nullptr, 0);
  }
  ::close(master_);
  ::close(slave_);
}

void Pty::type(const std::string& bytes) const {
  for (std::size_t done = 0; done < bytes.size();) {
    pollfd ready{master_, POLLOUT, 0};
    if (::poll(&ready, 1, 1000) <= 0) return;
    const ssize_t written = ::write(master_, bytes.data() + done, std::min<std::size_t>(bytes.size() - done, 256));
    if (written <= 0) return;
    done += static_cast<std::size_t>(written);
  }
}

void Pty::resize(unsigned short columns, unsigned short lines) const {
  const winsize size{.ws_row = lines, .ws_col = columns, .ws_xpixel = 0, .ws_ypixel = 0};
  ::ioctl(master_, TIOCSWINSZ, &size);
}

bool Pty::readOn(std::chrono::milliseconds limit) {
  pollfd ready{master_, POLLIN, 0};
  if (::poll(&ready, 1, static_cast<int>(limit.count())) <= 0 || (ready.revents & POLLIN) == 0) return false;
  std::array<char, 65536> piece;
  const ssize_t size = ::read(master_, piece.data(), piece.size());
  if (size > 0) output_.append(piece.data(), static_cast<std::size_t>(size));
  return size > 0;
}

bool Pty::shows(const std::string& text) {
  const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(15);
  while (output_.find(text) == std::string::npos) {
    if (std::chrono::steady_clock::now() > end) return false;
    readOn(std::chrono::milliseconds(50));
  }
  return true;
}

const std::string& Pty::output() {
  while (readOn(std::chrono::milliseconds(50))) {
  }
  return output_;
}

termios Pty::modes() const {
  termios modes{};
  ::tcgetattr(slave_, &modes);
  return modes;
}

std::optional<int> Pty::waitForEnd(std::chrono::milliseconds limit) {
  const auto end = std::chrono::steady_clock::now() + limit;
  while (true) {
    int status = 0;
    if (::waitpid(program_, &status, WNOHANG) == program_) {
      program_ = -1;
      return status;
    }
    if (std::chrono::steady_clock::now() > end) return std::nullopt;
    std::this_thread::sleep_for(std::chrono::milliseconds(5));
  }
}

}  // namespace vespscope::test
