// The viewer on its simulated drive in a real terminal.
#include <memory>
#include <string>

#include <gtest/gtest.h>

#include "support/Tmux.h"

namespace vespscope::test {
namespace {

class TerminalFrontendViewer : public ::testing::Test {
 protected:
  void SetUp() override {
    if (!Tmux::available()) GTEST_SKIP() << "tmux is not installed";
    tmux = std::make_unique<Tmux>(80, 24);
    // The environment of the tests may name a display, where the viewer would open a window.
    tmux->command("unset DISPLAY WAYLAND_DISPLAY QT_QPA_PLATFORM");
  }

  void start(const std::string& environment = "") {
    tmux->command(environment + " " VESPSCOPE_BIN_DIR
                                "/vespscope --manager embedded:scenario,speed=10; echo status=$?");
    ASSERT_TRUE(tmux->shows("Device Info"));
  }
  void expectEnd() {
    EXPECT_TRUE(tmux->shows("status=0"));
    tmux->command("echo back at the shell");
    EXPECT_TRUE(tmux->shows("\nback at the shell"));
  }

  std::unique_ptr<Tmux> tmux;
};

TEST_F(TerminalFrontendViewer, FromTheLaunchListToLiveValuesAndBack) {
  start();
  EXPECT_TRUE(tmux->shows("SIMULATED scenario"));
  tmux->press({"Down", "Enter"});
  EXPECT_TRUE(tmux->shows("vespscope › LTE\n"));
  EXPECT_TRUE(tmux->shows("Active Bearers"));
  tmux->press({"Down", "Down", "Enter"});
  EXPECT_TRUE(tmux->shows("vespscope › LTE › Serving Cell Info "));
  EXPECT_TRUE(tmux->shows("phy_cell_id"));
  tmux->press({"/", "t", "r", "a", "c", "k", "Enter"});
  EXPECT_TRUE(tmux->shows("1 of 12 rows with \"track\""));
  tmux->press({"Escape"});
  EXPECT_TRUE(tmux->shows("phy_cell_id"));
  tmux->press({"l"});
  EXPECT_TRUE(tmux->shows("out  Metric ID in Hex = 3C"));
  tmux->press({"/", "S", "I", "M", "Space", "f", "i", "l", "e", "s", "Enter"});
  EXPECT_TRUE(tmux->shows("out  Querying SIM files"));
  tmux->press({"Escape", "?"});
  EXPECT_TRUE(tmux->shows("previous, next row"));
  tmux->press({"Escape"});
  tmux->resize(40, 12);
  EXPECT_TRUE(tmux->shows("? help ─\n"));
  tmux->resize(1, 1);
  EXPECT_TRUE(tmux->becomes([](const std::string& screen) { return screen.size() <= 2; }));
  tmux->resize(80, 24);
  EXPECT_TRUE(tmux->shows("vespscope › LTE › Serving Cell Info "));
  tmux->press({"Escape", "q"});
  expectEnd();
}

TEST_F(TerminalFrontendViewer, ATerminatingSignalEndsItInOrder) {
  tmux->command("sh -c '(sleep 3; kill $$) & exec " VESPSCOPE_BIN_DIR
                "/vespscope --manager embedded:scenario'; echo status=$?");
  ASSERT_TRUE(tmux->shows("Device Info"));
  expectEnd();
}

TEST_F(TerminalFrontendViewer, AnOldTerminalAndAnAsciiLocaleAreEnough) {
  start("TERM=vt100 LC_ALL=C");
  tmux->press({"j", "Enter", "j", "j", "Enter"});
  EXPECT_TRUE(tmux->shows("vespscope > LTE > Serving Cell Info"));
  EXPECT_TRUE(tmux->shows(" timestamp           20"));
  tmux->press({"q"});
  expectEnd();
}

}  // namespace
}  // namespace vespscope::test
