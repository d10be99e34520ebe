// The terminal interface when its terminal accepts no output, and its output to one that does.
#include <signal.h>
#include <sys/wait.h>

#include <chrono>
#include <string>
#include <thread>

#include <gtest/gtest.h>

#include "support/Pty.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;

const std::string fixture = VESPSCOPE_BIN_DIR "/terminal_fixture";
constexpr const char* leaveScreen = "\x1b[?1049l";

bool sameModes(const termios& one, const termios& other) {
  return one.c_iflag == other.c_iflag && one.c_oflag == other.c_oflag && one.c_cflag == other.c_cflag &&
         one.c_lflag == other.c_lflag;
}

class TerminalFrontend : public ::testing::Test {
 protected:
  // Sends the signal to a program that is blocked in painting, and expects its end and the previous state of the
  // terminal.
  void endWith(int signal) {
    for (int turn = 0; turn < 30; ++turn) {  // paint the whole screen repeatedly
      terminal.resize(turn % 2 == 0 ? 200 : 190, 60);
      std::this_thread::sleep_for(20ms);
    }
    const auto before = std::chrono::steady_clock::now();
    ::kill(terminal.program(), signal);
    const auto end = terminal.waitForEnd(10s);
    ASSERT_TRUE(end.has_value());
    EXPECT_LT(std::chrono::steady_clock::now() - before, 2s);
    EXPECT_TRUE(WIFEXITED(*end) && WEXITSTATUS(*end) == 0) << *end;
    EXPECT_TRUE(sameModes(terminal.modes(), found));
    EXPECT_NE(terminal.output().find(leaveScreen), std::string::npos);
  }

  Pty terminal{{fixture}};
  const termios found = terminal.modes();
};

TEST_F(TerminalFrontend, EndsOnSigtermWhileNothingReadsFromItsTerminal) {
  ASSERT_TRUE(terminal.shows("Fail elsewhere"));
  endWith(SIGTERM);
}

TEST_F(TerminalFrontend, EndsOnSighupWhileNothingReadsFromItsTerminal) {
  ASSERT_TRUE(terminal.shows("Fail elsewhere"));
  endWith(SIGHUP);
}

TEST_F(TerminalFrontend, EndsOnSigtermWhileItsTerminalIsStopped) {
  ASSERT_TRUE(terminal.shows("Fail elsewhere"));
  terminal.type("\x13");  // Ctrl-S
  endWith(SIGTERM);
}

TEST_F(TerminalFrontend, EndsOnSighupWhileItsTerminalIsStopped) {
  ASSERT_TRUE(terminal.shows("Fail elsewhere"));
  terminal.type("\x13");
  endWith(SIGHUP);
}

TEST_F(TerminalFrontend, AsksForMarksAroundPastedTextAsLongAsItRuns) {
  ASSERT_TRUE(terminal.shows("\x1b[?2004h"));
  ASSERT_TRUE(terminal.shows("Fail elsewhere"));
  EXPECT_EQ(terminal.output().find("\x1b[?2004l"), std::string::npos);
  terminal.type("q");
  EXPECT_TRUE(terminal.waitForEnd(10s).has_value());
  const std::string& output = terminal.output();
  EXPECT_GT(output.rfind("\x1b[?2004l"), output.rfind("\x1b[?2004h"));
  EXPECT_NE(output.rfind("\x1b[?2004l"), std::string::npos);
}

TEST_F(TerminalFrontend, RestoresAStoppedTerminalThatItDoesNotPaintJustThen) {
  ASSERT_TRUE(terminal.shows("Fail elsewhere"));
  terminal.type("\x13");
  std::this_thread::sleep_for(100ms);
  ::kill(terminal.program(), SIGTERM);
  const auto end = terminal.waitForEnd(2s);
  ASSERT_TRUE(end.has_value());
  EXPECT_TRUE(WIFEXITED(*end) && WEXITSTATUS(*end) == 0) << *end;
  EXPECT_TRUE(sameModes(terminal.modes(), found));
  EXPECT_NE(terminal.output().find(leaveScreen), std::string::npos);
}

TEST_F(TerminalFrontend, AHundredKilobytesPastedIntoTheFilterDelayNeitherTheScreenNorTheEnd) {
  ASSERT_TRUE(terminal.shows("Fail elsewhere"));
  const auto before = std::chrono::steady_clock::now();
  std::jthread typist([this] { terminal.type("/" + std::string(100'000, 'x')); });
  ASSERT_TRUE(terminal.shows("0 of 6"));
  ::kill(terminal.program(), SIGTERM);
  const auto end = terminal.waitForEnd(2s);
  ASSERT_TRUE(end.has_value());
  EXPECT_TRUE(WIFEXITED(*end) && WEXITSTATUS(*end) == 0) << *end;
  EXPECT_LT(std::chrono::steady_clock::now() - before, 5s);
}

TEST_F(TerminalFrontend, SendsACopiedRowToTheTerminalsClipboard) {
  ASSERT_TRUE(terminal.shows("Fail elsewhere"));
  terminal.type("y");
  EXPECT_TRUE(terminal.shows("\x1b]52;c;VmFsdWVz\x07"));  // "Values"
  EXPECT_TRUE(terminal.shows("Copied Values"));
}

}  // namespace
}  // namespace vespscope::test
