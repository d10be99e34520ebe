// A terminal for tests: a separate tmux session with a shell.
#pragma once

#include <chrono>
#include <filesystem>
#include <functional>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/TemporaryFolder.h"

namespace vespscope::test {

class Tmux {
 public:
  static bool available();

  // Starts a shell with the prompt "$ " in a terminal of that size.
  Tmux(int width, int height);
  Tmux(const Tmux&) = delete;
  Tmux& operator=(const Tmux&) = delete;
  ~Tmux();

  // Types a command line for the shell.
  void command(const std::string& line);
  // Presses keys by tmux's names: "j", "Enter", "Escape", "C-z", "PageDown".
  void press(const std::vector<std::string>& keys);
  // Sends bytes as if they came from the terminal.
  void send(const std::string& bytes);
  void resize(int width, int height);
  // Closes the terminal while programs run in it.
  void hangUp();

  // The terminal's contents; with `looks`, with escape sequences for colours and attributes.
  [[nodiscard]] std::string screen(bool looks = false) const;

  // Waits until the screen contains a text, or until it is as wanted, for at most 15 s.
  [[nodiscard]] ::testing::AssertionResult shows(const std::string& text) const;
  [[nodiscard]] ::testing::AssertionResult becomes(const std::function<bool(const std::string&)>& wanted) const;

  // A folder that is removed with the session.
  [[nodiscard]] const std::filesystem::path& folder() const { return folder_.path(); }

 private:
  std::string tmux(std::vector<std::string> arguments) const;

  TemporaryFolder folder_;
  bool ended_ = false;
};

}  // namespace vespscope::test
