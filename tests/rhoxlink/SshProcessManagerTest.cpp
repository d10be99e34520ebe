// The manager of another machine, through ssh: here a script in ssh's place, which runs the far command on this
// machine.
#include <fcntl.h>
#include <signal.h>
#include <sys/stat.h>
#include <unistd.h>

#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <memory>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "rhoxlink/Rhoxlink.h"
#include "support/Eventually.h"
#include "support/OtherUser.h"
#include "support/Process.h"
#include "support/ServiceBus.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using ::testing::HasSubstr;

const std::filesystem::path programs = VESPSCOPE_BIN_DIR;

class SshProcessManager : public ::testing::Test {
 protected:
  SshProcessManager() { useNoBus(); }

  // Puts a shell script in ssh's place. It finds rhoxd as $RHOXD, and its own words as the real one does.
  void ssh(const std::string& script) const {
    const std::string file =
        folder.write("ssh", "#!/bin/sh\necho \"$@\" >> " + (folder / "words") + "\necho $$ > " + (folder / "pid") +
                                "\nRHOXD=" + (programs / "rhoxd").string() + "\n" + script + "\n");
    ::chmod(file.c_str(), 0755);
    ::setenv("PATH", (folder.path().string() + ":" + path).c_str(), 1);
  }

  [[nodiscard]] std::string contentsOf(const std::string& name) const {
    std::ifstream file(folder / name);
    return {std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>()};
  }

  [[nodiscard]] static std::shared_ptr<rhox::client::Manager> connect() {
    rhox::client::setAddress(*rhox::client::Address::parse("ssh:me@phone"));
    return rhox::client::CreateManager("test", nullptr);
  }

  // What the user is told after an attempt that fails.
  [[nodiscard]] std::string problemOf(const std::string& script) const {
    ssh(script);
    const auto manager = connect();
    EXPECT_TRUE(eventually([&] { return !connectionStatus(manager).problem.empty(); }, 10s));
    return connectionStatus(manager).problem;
  }

  const TemporaryFolder folder;
  const std::string path = std::getenv("PATH");
};

TEST_F(SshProcessManager, RunsRhoxdThereAndShowsWhatItDelivers) {
  ssh("exec \"$RHOXD\" --stdio --source scenario:seed=3,speed=20 --state none");
  Process screen(programs / "vespscope", {"--ui", "none", "--manager", "ssh:me@phone"});
  EXPECT_TRUE(screen.waitForOutput("Received RSRP RSRQ SINR")) << screen.errors();
  EXPECT_THAT(contentsOf("words"), HasSubstr("-o BatchMode=yes"));
  EXPECT_THAT(contentsOf("words"), HasSubstr(" -- me@phone rhoxd --stdio\n"));
  const pid_t far = std::stoi(contentsOf("pid"));
  screen.signal(SIGTERM);
  EXPECT_EQ(screen.wait(), (ProcessEnd{false, 0}));
  // The far end goes with its viewer.
  EXPECT_TRUE(eventually([far] { return ::kill(far, 0) != 0; }));
}

TEST_F(SshProcessManager, ConnectsAgainAfterTheLineBroke) {
  ssh("exec \"$RHOXD\" --stdio --source scenario:seed=3,speed=20 --state " + (folder / "state"));
  Process screen(programs / "vespscope", {"--ui", "none", "--manager", "ssh:me@phone"});
  ASSERT_TRUE(screen.waitForOutput("Received RSRP RSRQ SINR")) << screen.errors();
  const std::size_t before = screen.output().size();
  ASSERT_EQ(::kill(std::stoi(contentsOf("pid")), SIGKILL), 0);
  EXPECT_TRUE(screen.waitForOutput("Received SIM Card File Info", before));
  EXPECT_TRUE(screen.waitForOutput("Received RSRP RSRQ SINR", before));
}

TEST_F(SshProcessManager, UsesTheFarMachinesServiceWhereThereIsOne) {
  const ServiceBus bus({programs / "rhoxd", "--system", "--source", "scenario:seed=5,speed=20", "--state", "none",
                        "--group", ServiceBus::group});
  ssh("exec \"$RHOXD\" --stdio");
  Process screen(programs / "vespscope", {"--ui", "none", "--manager", "ssh:me@phone"});
  EXPECT_TRUE(screen.waitForOutput("Received RSRP RSRQ SINR")) << screen.errors();
  const pid_t service = bus.managerProcess();
  EXPECT_GT(service, 0);
  // The service restarted under it: the relay ends, and is started anew like it.
  const std::size_t before = screen.output().size();
  ASSERT_EQ(::kill(service, SIGKILL), 0);
  EXPECT_TRUE(eventually([&] { return bus.managerProcess() != service && bus.managerProcess() != 0; }, 20s));
  EXPECT_GT(before, 0U);
}

TEST_F(SshProcessManager, SaysWhatSshSaidWhenItFailed) {
  EXPECT_EQ(problemOf("echo 'some banner' >&2; echo 'ssh: Could not resolve hostname phone: Name or service not known' "
                      ">&2; exit 255"),
            "ssh to me@phone: ssh: Could not resolve hostname phone: Name or service not known");
  EXPECT_EQ(problemOf("printf 'me@phone: Permission denied (publickey).\\r\\n' >&2; exit 255"),
            "ssh to me@phone: me@phone: Permission denied (publickey).");
  EXPECT_EQ(problemOf("echo 'bash: line 1: rhoxd: command not found' >&2; exit 127"),
            "ssh to me@phone: rhoxd is not installed there (bash: line 1: rhoxd: command not found)");
  EXPECT_EQ(problemOf("exit 3"), "ssh to me@phone ended with status 3");
  // Whoever holds its error output open does not hold up the viewer.
  EXPECT_EQ(problemOf("sleep 60 0</dev/null >/dev/null & echo 'Connection closed.' >&2; exit 255"),
            "ssh to me@phone: Connection closed.");
}

TEST_F(SshProcessManager, ReportsToAWaitingCommandWhyItFailed) {
  ssh("head -c 1 >/dev/null; echo 'ssh: connect to host phone port 22: No route to host' >&2; exit 255");
  ipc::Object reply;
  const auto asked = rhox::client::PerformCommand(connect(), rhox::kCommandStatus, {}, reply);
  EXPECT_NE(asked.status, 0);
  EXPECT_THAT(asked.message, HasSubstr("ssh to me@phone: ssh: connect to host phone port 22: No route to host"));
}

TEST_F(SshProcessManager, ThatIsNotInstalledIsReportedAsSuch) {
  ::setenv("PATH", "/nonexistent", 1);
  const auto manager = connect();
  EXPECT_EQ(connectionStatus(manager).problem, "ssh cannot be started: No such file or directory");
}

TEST_F(SshProcessManager, DoesNotWaitForAnErrorOutputThatNobodyReads) {
  ssh("head -c 1000000 /dev/zero | tr '\\\\0' 'x' >&2; exec \"$RHOXD\" --stdio --source scenario --state none");
  const auto manager = connect();
  EXPECT_TRUE(eventually([&] { return connectionStatus(manager).connected; }, 10s));
}

// Standard input and output belong to whoever started the program: their pipes are out of other users' reach.
TEST_F(SshProcessManager, NoOtherUserReachesThePipesOfTheFarEnd) {
  if (::geteuid() != 0) GTEST_SKIP() << "only the administrator can act as other users";
  ssh("exec \"$RHOXD\" --stdio --source scenario --state none");
  const auto manager = connect();
  ASSERT_TRUE(eventually([&] { return connectionStatus(manager).connected; }, 10s));
  const std::string process = "/proc/" + std::to_string(std::stoi(contentsOf("pid"))) + "/fd/";
  const auto openAll = [&process] {
    int opened = 0;
    for (int descriptor = 0; descriptor < 64; ++descriptor) {
      for (const int flags : {O_RDONLY, O_WRONLY}) {
        if (::open((process + std::to_string(descriptor)).c_str(), flags | O_NONBLOCK) >= 0) ++opened;
      }
    }
    return std::to_string(opened);
  };
  EXPECT_NE(asUser(0, {}, openAll), "0");  // the way is one at all
  EXPECT_EQ(asUser(nobody, {}, openAll), "0");
}

}  // namespace
}  // namespace vespscope::test
