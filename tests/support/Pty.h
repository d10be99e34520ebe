// A terminal simulated by a test: it reads what a program writes to it, or does not.
#pragma once

#include <sys/types.h>
#include <termios.h>

#include <chrono>
#include <optional>
#include <string>
#include <vector>

namespace vespscope::test {

class Pty {
 public:
  // Starts the program in a terminal of 80x24 cells as its controlling terminal.
  explicit Pty(const std::vector<std::string>& command);
  Pty(const Pty&) = delete;
  Pty& operator=(const Pty&) = delete;
  // Kills the program if it is still running.
  ~Pty();

  [[nodiscard]] pid_t program() const { return program_; }
  // Types bytes; those that the program does not read in time are lost.
  void type(const std::string& bytes) const;
  void resize(unsigned short columns, unsigned short lines) const;

  // Reads until the output contains `text`, at most 15 s.
  [[nodiscard]] bool shows(const std::string& text);
  // Reads the available output, and returns all output so far.
  const std::string& output();
  // The terminal's modes.
  [[nodiscard]] termios modes() const;

  // The exit status of the program, as from waitpid; empty when it still runs after `limit`.
  [[nodiscard]] std::optional<int> waitForEnd(std::chrono::milliseconds limit);

 private:
  bool readOn(std::chrono::milliseconds limit);

  int master_ = -1;
  int slave_ = -1;  // kept open, so that the modes remain when the program ends
  pid_t program_ = -1;
  std::string output_;
};

}  // namespace vespscope::test
