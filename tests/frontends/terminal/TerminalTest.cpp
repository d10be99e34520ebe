// The terminal interface in a real terminal: its drawing, and that it restores the terminal.
#include <signal.h>
#include <unistd.h>

#include <algorithm>
#include <fstream>
#include <sstream>
#include <thread>

#include <gtest/gtest.h>

#include "support/Tmux.h"
#include "values/Sanitized.h"

namespace vespscope::test {
namespace {

const std::string fixture = VESPSCOPE_BIN_DIR "/terminal_fixture";

class TerminalTest : public ::testing::Test {
 protected:
  void SetUp() override {
    if (!Tmux::available()) GTEST_SKIP() << "tmux is not installed";
    tmux = std::make_unique<Tmux>(80, 24);
    tmux->command("cd; stty -a > before; echo marker");
    ASSERT_TRUE(tmux->shows("\nmarker"));
  }

  // Starts the program and waits for its first screen.
  void start(const std::string& environment = "", const std::string& rest = "") {
    tmux->command(environment + " " + fixture + " " + rest + "; echo status=$?");
    ASSERT_TRUE(tmux->shows("? help"));  // the last line: the screen is complete
  }
  // The process identifier of the running program, from its own screen.
  pid_t process() {
    tmux->press({"Enter"});
    EXPECT_TRUE(tmux->shows("phy_cell_id"));
    const std::string screen = tmux->screen();
    const std::size_t at = screen.find("process");
    return static_cast<pid_t>(std::stol(screen.substr(at + 7)));
  }
  // The shell's screen is visible again, and the terminal has its previous modes.
  void expectRestored() {
    EXPECT_TRUE(tmux->shows("marker\n$"));
    tmux->command("clear; stty -a > after; cmp before after && echo same modes");
    EXPECT_TRUE(tmux->shows("same modes"));
  }
  static std::string line(const std::string& screen, int number) {
    std::istringstream lines(screen);
    std::string text;
    for (int index = 0; index <= number; ++index) std::getline(lines, text);
    return text;
  }

  std::unique_ptr<Tmux> tmux;
};

TEST_F(TerminalTest, ItDrawsTheFirstScreenAndQuitsToTheShellAsItWas) {
  start();
  const std::string screen = tmux->screen();
  EXPECT_EQ(line(screen, 0), "fixture");
  EXPECT_EQ(line(screen, 2), "▸  Values          ›");
  EXPECT_EQ(line(screen, 22), "SIMULATED fixture · connected · 0/s · 0 decode failures · no event");
  EXPECT_EQ(screen.find("marker"), std::string::npos);
  tmux->press({"q"});
  EXPECT_TRUE(tmux->shows("status=0"));
  EXPECT_TRUE(tmux->shows("the fixture ends"));
  EXPECT_EQ(tmux->screen().find("the fixture starts"), std::string::npos);
  expectRestored();
}

TEST_F(TerminalTest, KeysReachTheScreens) {
  start();
  tmux->press({"Right"});
  EXPECT_TRUE(tmux->shows("fixture › Values"));
  EXPECT_TRUE(tmux->shows("provider     中国 ␛[31m"));
  tmux->press({"Escape"});
  EXPECT_TRUE(tmux->shows("▸  Values          ›"));
  tmux->press({"Down", "j", "Up"});
  EXPECT_TRUE(tmux->shows("▸  Fail here"));
  tmux->press({"End"});
  EXPECT_TRUE(tmux->shows("▸  Log"));
  tmux->press({"Home", "Enter"});
  EXPECT_TRUE(tmux->shows("fixture › Values"));
  tmux->press({"/", "1", "8", "5"});
  EXPECT_TRUE(tmux->shows("▸  phy_cell_id  185"));
  tmux->press({"BSpace", "BSpace", "BSpace", "BSpace", "BSpace"});
  EXPECT_TRUE(tmux->shows("▸  Values          ›"));
  tmux->press({"?"});
  EXPECT_TRUE(tmux->shows("previous, next row"));
}

TEST_F(TerminalTest, PastedTextIsTextAndNeverAKey) {
  // As a terminal sends it that puts marks around pasted text.
  const auto pasted = [](const std::string& text) { return "\x1b[200~" + text + "\x1b[201~"; };
  start();
  tmux->send(pasted("q\rl?"));
  tmux->press({"Down"});
  EXPECT_TRUE(tmux->shows("▸  Fail here"));
  tmux->press({"/"});
  tmux->send(pasted("fail\rhere\r"));
  EXPECT_TRUE(tmux->becomes([](const std::string& screen) {
    return screen.find("Fail here") != std::string::npos && screen.find("Fail elsewhere") == std::string::npos;
  })) << tmux->screen();
  tmux->press({"x"});
  EXPECT_TRUE(tmux->shows("No row contains “fail herex”"));
  // The mark of the end was lost: the key is none of the text.
  tmux->send("\x1b[200~");
  tmux->press({"Escape"});
  EXPECT_TRUE(tmux->shows("Fail elsewhere"));
  tmux->press({"q"});
  EXPECT_TRUE(tmux->shows("status=0"));
  expectRestored();
}

TEST_F(TerminalTest, TheLogPaneHoldsLinesFromBeforeItWasDrawn) {
  start();
  tmux->press({"End", "Enter"});
  EXPECT_TRUE(tmux->shows("fixture › Log"));
  tmux->press({"l"});
  EXPECT_TRUE(tmux->shows("out  the fixture starts"));
  EXPECT_TRUE(tmux->shows("out  a line from the fixture"));
}

TEST_F(TerminalTest, TheMouseOpensRowsAndGoesBack) {
  start();
  // In the encoding in this terminal's description: button (0: the first one, 3: released), column and line, each plus
  // 32; column and line count from 1.
  const auto click = [this](int column, int line) {
    const std::string place{static_cast<char>(33 + column), static_cast<char>(33 + line)};
    tmux->send("\x1b[M " + place + "\x1b[M#" + place);
  };
  click(5, 2);
  EXPECT_TRUE(tmux->shows("fixture › Values"));
  click(3, 0);
  EXPECT_TRUE(tmux->shows("Fail elsewhere"));
}

TEST_F(TerminalTest, SignalsThatEndItRestoreTheTerminal) {
  for (const int signal : {SIGTERM, SIGINT, SIGHUP}) {
    start();
    ::kill(process(), signal);
    EXPECT_TRUE(tmux->shows("status=0")) << signal;
    expectRestored();
    tmux->command("clear; echo marker");
    ASSERT_TRUE(tmux->shows("marker\n$"));
  }
}

TEST_F(TerminalTest, ControlCEndsIt) {
  start();
  tmux->press({"C-c"});
  EXPECT_TRUE(tmux->shows("status=0"));
  expectRestored();
}

TEST_F(TerminalTest, WhenItsTerminalIsGoneItEndsInOrder) {
  // The leak checker of sanitizer builds hangs when the signal arrives during its search.
  tmux->command("ASAN_OPTIONS=detect_leaks=0 bash -c 'trap \"\" HUP; " + fixture + "; echo status=$? > ended'");
  ASSERT_TRUE(tmux->shows("Fail elsewhere"));
  const std::string name = (tmux->folder() / "ended").string();
  tmux->hangUp();
  std::string text;
  for (int attempt = 0; attempt < 1500 && text.empty(); ++attempt) {
    std::getline(std::ifstream(name) >> std::ws, text);
    std::this_thread::sleep_for(std::chrono::milliseconds(10));
  }
  EXPECT_EQ(text, "status=0");
}

TEST_F(TerminalTest, AProgrammingErrorRestoresTheTerminalAndSaysOneLine) {
  start("LC_ALL=C.UTF-8");
  tmux->press({"Down", "Enter"});
  EXPECT_TRUE(tmux->shows("fatal: a stop on the main thread (TerminalFixture.cpp:"));
  EXPECT_TRUE(tmux->shows("status=134"));
  expectRestored();
}

TEST_F(TerminalTest, AProgrammingErrorOnAnotherThreadDoesToo) {
  start();
  tmux->press({"Down", "Down", "Enter"});
  EXPECT_TRUE(tmux->shows("fatal: a stop on another thread (TerminalFixture.cpp:"));
  EXPECT_TRUE(tmux->shows("status=134"));
  expectRestored();
}

TEST_F(TerminalTest, ALoopThatIsStoppedEndsItWithItsCode) {
  start();
  tmux->press({"j", "j", "j", "Enter"});
  EXPECT_TRUE(tmux->shows("status=7"));
  expectRestored();
}

TEST_F(TerminalTest, ItSuspendsToTheShellAndComesBack) {
  start();
  tmux->press({"Enter"});
  EXPECT_TRUE(tmux->shows("fixture › Values"));
  tmux->press({"C-z"});
  EXPECT_TRUE(tmux->shows("Stopped"));
  EXPECT_TRUE(tmux->shows("\nmarker"));
  tmux->command("echo in between");
  EXPECT_TRUE(tmux->shows("\nin between"));
  tmux->command("fg; echo again=$?");
  EXPECT_TRUE(tmux->shows("fixture › Values"));
  tmux->press({"Escape", "q"});
  EXPECT_TRUE(tmux->shows("again=0"));
  expectRestored();
}

TEST_F(TerminalTest, NoLinesOfTheLogAreOnTheScreenAfterItWasSuspended) {
  start();
  tmux->press({"End", "Up", "Enter"});
  EXPECT_TRUE(tmux->shows("fixture › Chatter"));
  const std::string whole = tmux->screen();
  for (int round = 0; round < 3; ++round) {
    tmux->press({"C-z"});
    ASSERT_TRUE(tmux->shows("Stopped"));
    tmux->command("fg; echo again=$?");
    ASSERT_TRUE(tmux->shows("fixture › Chatter"));
    std::this_thread::sleep_for(std::chrono::milliseconds(300));
    EXPECT_EQ(tmux->screen(), whole) << round;
  }
  tmux->press({"q"});
  EXPECT_TRUE(tmux->shows("again=0"));
}

TEST_F(TerminalTest, HoweverFewDescriptorsThereAreTheTerminalIsRestored) {
  if (sanitized) GTEST_SKIP() << "the sanitizer opens a pipe to check an object, and reports it as invalid without one";
  for (int limit = 4; limit <= 16; ++limit) {
    tmux->command("clear; echo marker; (ulimit -n " + std::to_string(limit) + "; timeout --foreground 1 " + fixture +
                  ") 2> errors; echo limit=" + std::to_string(limit));
    EXPECT_TRUE(tmux->shows("\nlimit=" + std::to_string(limit) + "\n$")) << limit;
    EXPECT_TRUE(tmux->shows("marker\n")) << limit;  // not on the interface's own screen
    tmux->command("clear; stty -a > after; cmp before after && echo same modes");
    EXPECT_TRUE(tmux->shows("same modes")) << limit;
  }
}

TEST_F(TerminalTest, ASizeThatNoTerminalHasIsReportedAsThat) {
  tmux->command("COLUMNS=99999999 " + fixture + "; echo status=$?");
  EXPECT_TRUE(tmux->shows("no terminal interface: COLUMNS is 99999999, and a terminal"));
  EXPECT_TRUE(tmux->shows("status=1"));
  tmux->command("clear; LINES=100000 " + fixture + "; echo status=$?");
  EXPECT_TRUE(tmux->shows("no terminal interface: LINES is 100000, and a terminal"));
}

TEST_F(TerminalTest, ATerminalTypeCannotBringControlCharactersIntoTheError) {
  tmux->command("TERM=$'x\\e]0;title\\a' " + fixture + " 2> errors; grep -c $'\\e' errors");
  EXPECT_TRUE(tmux->shows("\n0\n"));
  tmux->command("clear; cat errors");
  EXPECT_TRUE(tmux->shows("the terminal type \"x␛]0;title␇\" is not known"));
}

TEST_F(TerminalTest, ItFollowsTheTerminalsSizeDownToOneCellAndBack) {
  start();
  tmux->resize(40, 12);
  EXPECT_TRUE(tmux->becomes([](const std::string& screen) {
    return line(screen, 1).size() > 40 && line(screen, 1).find("? help") != std::string::npos;
  }));
  EXPECT_TRUE(tmux->shows("▸  Values          ›"));
  tmux->resize(40, 11);
  EXPECT_TRUE(tmux->shows("terminal too small (40x11, needs 40x12)"));
  tmux->resize(1, 1);
  // Terminals that wrap at their edge cannot show a character in their last cell.
  EXPECT_TRUE(tmux->becomes([](const std::string& screen) { return screen == "t\n" || screen == "\n"; }));
  tmux->resize(7, 3);
  EXPECT_TRUE(tmux->shows("termina"));
  tmux->resize(120, 40);
  EXPECT_TRUE(tmux->shows("SIMULATED fixture · connected · 0 events/s · 0 events · 0 decode failures · no event yet"));
  tmux->resize(80, 24);
  EXPECT_TRUE(tmux->shows("enter open   / filter   y copy   l log   ? help   q quit"));
  tmux->press({"q"});
  EXPECT_TRUE(tmux->shows("status=0"));
}

TEST_F(TerminalTest, ControlLRepairsTheScreen) {
  start(
      "T=$(tty) sh -c '(while [ ! -e scribble ]; do sleep 0.02; done; printf \"\\033[5;1Hscribble\" > $T) & exec "
      "\"$0\"'");
  const std::string whole = tmux->screen();
  std::ofstream(tmux->folder() / "scribble").put('x');
  ASSERT_TRUE(tmux->shows("\nscribble"));
  tmux->press({"C-l"});
  EXPECT_TRUE(tmux->becomes([&whole](const std::string& screen) { return screen == whole; }));
}

bool hasColour(const std::string& screen) {
  for (std::size_t at = screen.find("\x1b["); at != std::string::npos; at = screen.find("\x1b[", at + 1)) {
    const std::size_t end = screen.find('m', at);
    const std::string sequence = screen.substr(at + 2, end - at - 2);
    std::istringstream parts(sequence);
    for (std::string part; std::getline(parts, part, ';');) {
      if (part.size() == 2 && (part[0] == '3' || part[0] == '4') && part[1] != '9') return true;
    }
  }
  return false;
}

bool hasReverse(const std::string& screen) {
  return screen.find("\x1b[7m") != std::string::npos || screen.find(";7m") != std::string::npos;
}

bool isAscii(const std::string& text) {
  return std::all_of(text.begin(), text.end(), [](char byte) { return static_cast<unsigned char>(byte) < 0x80; });
}

TEST_F(TerminalTest, ColoursAreUsedWhereThereAreSome) {
  start();
  EXPECT_TRUE(hasColour(tmux->screen(true)));
}

TEST_F(TerminalTest, ColoursAreLeftOutWhenAskedToAndAttributesStay) {
  start("NO_COLOR=1");
  const std::string looks = tmux->screen(true);
  EXPECT_FALSE(hasColour(looks));
  EXPECT_TRUE(hasReverse(looks)) << looks;
}

TEST_F(TerminalTest, AnOldTerminalWithoutColoursIsEnough) {
  start("TERM=vt100");
  const std::string looks = tmux->screen(true);
  EXPECT_FALSE(hasColour(looks));
  EXPECT_TRUE(hasReverse(looks)) << looks;
  tmux->press({"Enter"});
  EXPECT_TRUE(tmux->shows("fixture › Values"));
  tmux->press({"q"});
  EXPECT_TRUE(tmux->shows("status=0"));
}

TEST_F(TerminalTest, WithoutAUtf8LocaleEverythingIsAscii) {
  start("LC_ALL=C");
  EXPECT_EQ(line(tmux->screen(), 2), ">  Values          >");
  tmux->press({"Enter"});
  EXPECT_TRUE(tmux->shows("provider     ?? ?[31m"));
  const std::string screen = tmux->screen();
  EXPECT_TRUE(isAscii(screen)) << screen;
}

TEST_F(TerminalTest, WithStandardOutputRedirectedItDrawsOnTheTerminalAndTheLinesGoToTheFile) {
  start("", "> lines");
  tmux->press({"q"});
  EXPECT_TRUE(tmux->shows("status=0"));
  tmux->command("cat lines");
  EXPECT_TRUE(tmux->shows("\nthe fixture starts\nthe fixture ends\n"));
}

TEST_F(TerminalTest, ATerminalThatCannotBeUsedIsAnErrorOfOneLine) {
  tmux->command("TERM=nonsense " + fixture + "; echo status=$?");
  EXPECT_TRUE(tmux->shows("vespscope: no terminal interface: the terminal type \"nonsense\" is not known;"));
  EXPECT_TRUE(tmux->shows("status=1"));
  tmux->command("clear; TERM=dumb " + fixture + "; echo status=$?");
  EXPECT_TRUE(tmux->shows("the terminal type \"dumb\" cannot place"));
  tmux->command("clear; setsid -w " + fixture + " </dev/null 2>&1 | cat; echo status=${PIPESTATUS[0]}");
  EXPECT_TRUE(tmux->shows("there is no terminal; --ui none does without\n"));
  EXPECT_TRUE(tmux->shows("status=1"));
}

TEST_F(TerminalTest, WhileNothingHappensItHardlyUsesTheProcessor) {
  start();
  const pid_t running = process();
  const auto used = [running] {
    std::ifstream file("/proc/" + std::to_string(running) + "/stat");
    std::string field;
    long ticks = 0;
    for (int number = 1; file >> field && number <= 15; ++number) {
      if (number >= 14) ticks += std::stol(field);
    }
    return ticks;
  };
  const long before = used();
  std::this_thread::sleep_for(std::chrono::milliseconds(700));
  EXPECT_LE(used() - before, ::sysconf(_SC_CLK_TCK) / 50);
}

}  // namespace
}  // namespace vespscope::test
