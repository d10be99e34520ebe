// The baseband manager as a user starts it.
#include <signal.h>
#include <unistd.h>

#include <filesystem>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "support/Process.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using ::testing::HasSubstr;
using ::testing::StartsWith;

const std::filesystem::path daemonProgram = std::filesystem::path(VESPSCOPE_BIN_DIR) / "rhoxd";
const std::filesystem::path viewer = std::filesystem::path(VESPSCOPE_BIN_DIR) / "vespscope";

TEST(RhoxdProcess, PrintsItsVersionAndHelp) {
  Process version(daemonProgram, {"--version"});
  EXPECT_EQ(version.wait(), (ProcessEnd{false, 0}));
  EXPECT_EQ(version.output(), "rhoxd " VESPSCOPE_VERSION "\n");
  Process help(daemonProgram, {"--help"});
  EXPECT_EQ(help.wait(), (ProcessEnd{false, 0}));
  EXPECT_THAT(help.output(), HasSubstr("--listen unix:path=PATH"));
  EXPECT_THAT(help.output(), HasSubstr("scenario[:seed=N]"));
  EXPECT_EQ(help.errors(), "");
}

TEST(RhoxdProcess, RefusesBadWordsInOneLineWithStatusTwo) {
  const std::vector<std::pair<std::vector<std::string>, std::string>> table = {
      {{"--source"}, "--source"},
      {{"--listen", "here", "--source", "scenario"}, "--listen takes a socket, unix:path=PATH, not \"here\""},
      {{"--listen", "system", "--source", "scenario"}, "--listen takes a socket, unix:path=PATH, not \"system\""},
      {{"--listen", "tcp:1", "--source", "scenario"},
       "--listen takes a socket, unix:path=PATH, not \"tcp:1\"; clients of other machines come through ssh, which runs "
       "rhoxd --stdio"},
      {{"--listen", "unix:path=", "--source", "scenario"},
       "--listen takes a socket, unix:path=PATH, not \"unix:path=\""},
      {{"--listen", "unix:path=/tmp/x", "--source", "radio"}, "--source: source \"radio\": a source is scenario"},
      {{"--listen", "unix:path=/tmp/x", "--source", "scenario,speed=0"},
       "--source: source \"scenario,speed=0\": speed is a number"},
      {{"--listen", "unix:path=/tmp/x", "--source", "scenario", "--state", ""}, "--state: no folder is named"},
      {{"--nonsense", "--listen", "unix:path=/tmp/x", "--source", "scenario"}, "The following argument"},
  };
  for (const auto& [arguments, message] : table) {
    Process process(daemonProgram, arguments);
    EXPECT_EQ(process.wait(), (ProcessEnd{false, 2}));
    EXPECT_EQ(process.output(), "");
    EXPECT_THAT(process.errors(), StartsWith("rhoxd: " + message));
    EXPECT_EQ(process.errors().find('\n'), process.errors().size() - 1);
  }
}

TEST(RhoxdProcess, ThatCannotHaveItsSourceOrSocketSaysWhyWithStatusOne) {
  const TemporaryFolder folder;
  Process source(daemonProgram, {"--listen", "unix:path=" + (folder / "socket"), "--source", "replay:/no/such.pcap"});
  EXPECT_EQ(source.wait(), (ProcessEnd{false, 1}));
  EXPECT_THAT(source.errors(), StartsWith("rhoxd: /no/such.pcap"));
  const std::string file = folder.write("file", "");
  Process socket(daemonProgram, {"--listen", "unix:path=" + file, "--source", "scenario"});
  EXPECT_EQ(socket.wait(), (ProcessEnd{false, 1}));
  EXPECT_EQ(socket.errors(), "rhoxd: " + file + " exists and is not a socket\n");
}

TEST(RhoxdProcess, WithoutASocketServesTheSystemBusAndSaysSoWhenThereIsNone) {
  Process process(daemonProgram, {"--source", "scenario", "--state", "none"},
                  {{"DBUS_SYSTEM_BUS_ADDRESS", "unix:path=/nonexistent/bus"}});
  EXPECT_EQ(process.wait(), (ProcessEnd{false, 1}));
  EXPECT_EQ(process.errors(), "rhoxd: the system bus cannot be reached: No such file or directory\n");
}

TEST(RhoxdProcess, EndsCleanlyOnEachEndSignalAndRemovesItsSocket) {
  const TemporaryFolder folder;
  const std::string path = folder / "socket";
  for (const int number : {SIGINT, SIGTERM, SIGHUP}) {
    Process process(daemonProgram, {"--listen", "unix:path=" + path, "--source", "scenario:seed=3", "--state", "none"});
    ASSERT_TRUE(process.waitForOutput("rhoxd: ")) << process.errors();
    EXPECT_THAT(process.output(), HasSubstr(" at " + path + "\n"));
    EXPECT_EQ(::access(path.c_str(), F_OK), 0);
    process.signal(number);
    EXPECT_EQ(process.wait(), (ProcessEnd{false, 0}));
    EXPECT_NE(::access(path.c_str(), F_OK), 0);
  }
}

TEST(RhoxdProcess, KilledWithoutWarningComesBackWithItsConfigurationAndTheViewerWithIt) {
  const TemporaryFolder folder;
  const std::string address = "unix:path=" + (folder / "socket");
  const std::vector<std::string> arguments = {"--listen", address,         "--source", "scenario:seed=3,speed=20",
                                              "--state",  folder / "state"};
  auto first = std::make_unique<Process>(daemonProgram, arguments);
  ASSERT_TRUE(first->waitForOutput("rhoxd: ")) << first->errors();
  Process screen(viewer, {"--ui", "none", "--manager", address});
  ASSERT_TRUE(screen.waitForOutput("Received RSRP RSRQ SINR"));
  first->signal(SIGKILL);
  ASSERT_TRUE(first->wait().has_value());
  EXPECT_TRUE(std::filesystem::exists(folder / "socket"));
  const std::size_t before = screen.output().size();
  Process second(daemonProgram, arguments);
  ASSERT_TRUE(second.waitForOutput("rhoxd: ")) << second.errors();
  // The second manager's drive starts from the beginning, with the values that are reported only there.
  EXPECT_TRUE(screen.waitForOutput("Received SIM Card File Info", before));
  EXPECT_TRUE(screen.waitForOutput("Received RSRP RSRQ SINR", before));
  screen.signal(SIGTERM);
  EXPECT_EQ(screen.wait(), (ProcessEnd{false, 0}));
}

}  // namespace
}  // namespace vespscope::test
