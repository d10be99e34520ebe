// Programs end soon after a signal, also while they wait for somebody that stays silent.
#include <signal.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <unistd.h>

#include <chrono>
#include <cstring>
#include <filesystem>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "support/Process.h"
#include "support/TemporaryFolder.h"
#include "values/Sanitized.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;

// A socket where connections are taken and nothing is said.
class VespscopeEnding : public ::testing::Test {
 protected:
  VespscopeEnding() {
    sockaddr_un name{};
    name.sun_family = AF_UNIX;
    std::strncpy(name.sun_path, path_.c_str(), sizeof name.sun_path - 1);
    EXPECT_EQ(::bind(listening_, reinterpret_cast<const sockaddr*>(&name), sizeof name), 0);
    EXPECT_EQ(::listen(listening_, 8), 0);
  }
  ~VespscopeEnding() override { ::close(listening_); }

  // Asks the program to end while it waits, and expects that it does within two seconds.
  void endsSoon(const std::string& program, const std::vector<std::string>& arguments, const ProcessEnd& expected) {
    Process process(std::filesystem::path(VESPSCOPE_BIN_DIR) / program, arguments,
                    {{"DBUS_SYSTEM_BUS_ADDRESS", "unix:path=" + path_}});
    process.readFor(500ms);
    process.signal(SIGTERM);
    const auto begin = std::chrono::steady_clock::now();
    EXPECT_EQ(process.wait(), expected) << process.errors();
    if (!sanitized) {
      EXPECT_LT(std::chrono::steady_clock::now() - begin, 2s);
    }
  }

  const TemporaryFolder folder_;
  const std::string path_ = folder_ / "silent";
  const int listening_ = ::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0);
};

TEST_F(VespscopeEnding, DoesNotWaitForAManagerThatStaysSilent) {
  endsSoon("vespscope", {"--ui", "none", "--manager", "unix:path=" + path_}, {false, 0});
}

TEST_F(VespscopeEnding, DoesNotWaitForASystemBusThatStaysSilent) {
  endsSoon("vespscope", {"--ui", "none", "--manager", "system"}, {false, 0});
  endsSoon("vespscope", {"--ui", "none", "--manager", "auto"}, {false, 0});
}

using VespscopeEndingOfRhoxd = VespscopeEnding;

TEST_F(VespscopeEndingOfRhoxd, DoesNotWaitForASystemBusThatStaysSilent) {
  endsSoon("rhoxd",
           {"--system", "--listen", "unix:path=" + (folder_ / "socket"), "--source", "scenario", "--state", "none"},
           {true, SIGTERM});
  EXPECT_FALSE(std::filesystem::exists(folder_ / "socket"));
}

}  // namespace
}  // namespace vespscope::test
