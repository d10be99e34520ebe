// A client of a manager that is killed and restarted without its state.
#include <signal.h>

#include <atomic>
#include <filesystem>
#include <memory>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "platform/dispatch/SerialQueue.h"
#include "rhoxlink/Rhoxlink.h"
#include "support/Eventually.h"
#include "support/Process.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

const std::filesystem::path daemonProgram = std::filesystem::path(VESPSCOPE_BIN_DIR) / "rhoxd";

std::unique_ptr<Process> startManager(const std::string& socket) {
  auto process = std::make_unique<Process>(
      daemonProgram,
      std::vector<std::string>{"--listen", "unix:path=" + socket, "--source", "scenario:seed=3", "--state", "none"});
  EXPECT_TRUE(process->waitForOutput("rhoxd: ")) << process->errors();
  return process;
}

TEST(VespscopeReconnection, AManagerThatWasKilledAndStartedWithoutStateSendsEventsAgain) {
  const TemporaryFolder folder;
  const std::string socket = folder / "socket";
  auto daemon = startManager(socket);
  rhox::client::setAddress(*rhox::client::Address::parse("unix:path=" + socket));
  const auto queue = std::make_shared<dispatch::SerialQueue>("test");
  const auto manager = rhox::client::CreateManager("test", queue);
  const std::string toml = "[metrics]\nK_LTE_RRC_STATE = { on = \"event\" }\nK_LTE_TX_POWER = { on = \"event\" }\n";
  ipc::Dictionary request;
  request.set(rhox::kKeyAppID, ipc::Object(std::int64_t{2}));
  request.set(rhox::kKeyPayload, ipc::Object(Bytes(toml.begin(), toml.end())));
  request.set(rhox::kKeyPayloadType, ipc::Object(std::int64_t{0}));
  ipc::Object reply;
  const auto result = rhox::client::PerformCommand(manager, rhox::kCommandAddConfiguration, request, reply);
  ASSERT_EQ(result.status, 0) << result.message;
  rhox::client::EventsOn(manager);
  const auto received = [&manager] { return rhox::client::connectionStatus(manager).eventsReceived; };
  ASSERT_TRUE(eventually([&] { return received() > 0; }));
  EXPECT_EQ(rhox::client::connectionStatus(manager).protocol, rhox::kProtocol);

  daemon->signal(SIGKILL);
  static_cast<void>(daemon->wait());
  ASSERT_TRUE(eventually([&] { return !rhox::client::connectionStatus(manager).connected; }));
  const std::uint64_t before = received();
  daemon = startManager(socket);
  EXPECT_TRUE(eventually([&] { return received() > before; }));
  EXPECT_EQ(rhox::client::connectionStatus(manager).connections, 2U);
  EXPECT_EQ(rhox::client::connectionStatus(manager).notSubscribed, "");
}

}  // namespace
}  // namespace vespscope::test
