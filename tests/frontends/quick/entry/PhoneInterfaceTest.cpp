// The viewer's choice of its interface by the displays that the environment names.
#include <filesystem>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/Process.h"
#include "support/TemporaryFolder.h"
#include "support/Tmux.h"

namespace vespscope::test {
namespace {

using ::testing::EndsWith;
using ::testing::HasSubstr;
using ::testing::StartsWith;

const std::filesystem::path viewer = std::filesystem::path(VESPSCOPE_BIN_DIR) / "vespscope";
const std::map<std::string, std::string> deadDisplay = {
    {"DISPLAY", ":77"}, {"WAYLAND_DISPLAY", ""}, {"QT_QPA_PLATFORM", ""}};

TEST(PhoneInterface, AskedForOnADeadDisplayThePhoneInterfaceSaysSoAndEnds) {
  Process process(viewer, {"--ui", "quick"}, deadDisplay);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 2}));
  EXPECT_EQ(process.errors(), "vespscope: --ui quick: there is no display: DISPLAY=:77 does not open\n");
}

TEST(PhoneInterface, OnADeadDisplayTheViewerUsesTheTerminalInterfaceAndSaysWhy) {
  if (!Tmux::available()) GTEST_SKIP() << "tmux is not installed";
  Tmux tmux(100, 24);
  tmux.command("DISPLAY=:77 WAYLAND_DISPLAY= QT_QPA_PLATFORM= " + viewer.string() + " --manager embedded:scenario");
  ASSERT_TRUE(tmux.shows("Device Info"));
  tmux.press({"l", "/", "d", "i", "s", "p", "l", "a", "y", "Enter"});
  EXPECT_TRUE(tmux.shows("there is no display: DISPLAY=:77 does not open; this is the terminal interface"));
  tmux.press({"Escape", "q"});
  EXPECT_TRUE(tmux.shows("vespscope: there is no display: DISPLAY=:77 does not open; this is the terminal interface"));
}

TEST(PhoneInterface, OnADeadDisplayWithoutATerminalThereAreLogLines) {
  Process process(viewer, {"--manager", "embedded:scenario"}, deadDisplay);
  EXPECT_TRUE(process.waitForOutput("pushing metric file"));
  EXPECT_THAT(process.errors(), StartsWith("vespscope: there is no display: DISPLAY=:77 does not open; without a "
                                           "terminal too, there are log lines only\n"));
}

TEST(PhoneInterface, AToolkitThatDoesNotStartEndsTheViewerWithItsReason) {
  Process process(viewer, {"--ui", "quick"}, {{"QT_QPA_PLATFORM", "nowhere"}});
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 2}));
  EXPECT_THAT(process.errors(), HasSubstr("vespscope: the phone interface does not start: This application failed to "
                                          "start because no Qt platform plugin could be initialized"));
  EXPECT_THAT(process.errors(), EndsWith("(--ui terminal shows the same screens)\n"));
}

TEST(PhoneInterface, OnALiveDisplayTheWindowOpensByItself) {
  if (!std::filesystem::exists("/usr/bin/Xvfb")) GTEST_SKIP() << "xvfb is not installed";
  Process server("/usr/bin/Xvfb", {"-displayfd", "1", "-screen", "0", "1280x800x24", "-nolisten", "tcp"});
  ASSERT_TRUE(server.waitForOutput("\n"));
  const std::string display = ":" + server.output().substr(0, server.output().find('\n'));
  const TemporaryFolder runtime;
  Process process(viewer, {"--manager", "embedded:scenario"},
                  {{"DISPLAY", display},
                   {"WAYLAND_DISPLAY", ""},
                   {"QT_QPA_PLATFORM", ""},
                   {"QT_QUICK_BACKEND", "software"},
                   {"XDG_RUNTIME_DIR", runtime.path()},
                   {"QT_LOGGING_RULES", "vespscope.quick=true"}});
  EXPECT_TRUE(process.waitForErrors("first frame"));
  process.signal(SIGTERM);
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
  EXPECT_THAT(process.errors(), ::testing::Not(HasSubstr("qrc:"))) << "no warning of the window's description";
}

}  // namespace
}  // namespace vespscope::test
