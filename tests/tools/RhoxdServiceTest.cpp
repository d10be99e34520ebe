// The baseband manager as an installed service: on a system bus, with its own policy.
#include <signal.h>
#include <unistd.h>

#include <chrono>
#include <filesystem>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <grp.h>
#include <gtest/gtest.h>

#include "platform/dispatch/SerialQueue.h"
#include "rhoxlink/Rhoxlink.h"
#include "support/BusStranger.h"
#include "support/Eventually.h"
#include "support/OtherUser.h"
#include "support/Process.h"
#include "support/ServiceBus.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using ipc::Dictionary;
using ipc::Object;
using ::testing::Each;
using ::testing::HasSubstr;
using ::testing::Not;

const std::filesystem::path daemonProgram = std::filesystem::path(VESPSCOPE_BIN_DIR) / "rhoxd";
const std::filesystem::path viewer = std::filesystem::path(VESPSCOPE_BIN_DIR) / "vespscope";
const std::string denied = "org.freedesktop.DBus.Error.AccessDenied";

std::vector<std::string> serviceArguments(const std::string& state = "none") {
  return {"--system", "--source", "scenario:seed=3,speed=20", "--state", state, "--group", ServiceBus::group};
}

std::vector<std::string> serviceCommand(const std::string& state = "none") {
  std::vector<std::string> words = serviceArguments(state);
  words.insert(words.begin(), daemonProgram);
  return words;
}

// A client on the bus that records the metrics that arrive.
class Client {
 public:
  explicit Client(std::int64_t application) : application_(application) {
    rhox::client::setAddress(*rhox::client::Address::parse("system"));
    manager = rhox::client::CreateManager("client " + std::to_string(application), queue_);
    rhox::client::RegisterEventHandler(manager, rhox::kEventMetric,
                                       [this](const Object& event, const rhox::client::DispatchGroup&) {
                                         const std::lock_guard lock(mutex_);
                                         metrics_.push_back(*event.asDictionary()->find("kKeyMetricID")->asInt64());
                                       });
  }
  Client(const Client&) = delete;
  Client& operator=(const Client&) = delete;
  ~Client() {
    manager.reset();
    queue_->drain();
  }

  // Configures one metric, and turns events on.
  rhox::client::Result listen(const std::string& metric) {
    const std::string toml = "[metrics]\n" + metric + " = { period_ms = 1 }\n";
    Dictionary request;
    request.set(rhox::kKeyAppID, Object(application_));
    request.set(rhox::kKeyPayload, Object(Bytes(toml.begin(), toml.end())));
    request.set(rhox::kKeyPayloadType, Object(std::int64_t{0}));
    Object reply;
    const auto result = rhox::client::PerformCommand(manager, rhox::kCommandAddConfiguration, request, reply);
    rhox::client::EventsOn(manager);
    return result;
  }

  std::vector<std::int64_t> metrics() {
    const std::lock_guard lock(mutex_);
    return metrics_;
  }
  bool waitForMetrics(std::size_t count) {
    return eventually([&] { return metrics().size() >= count; }, 20s);
  }

  // The clients in the manager's status, including this one.
  ipc::Array clients() {
    Dictionary request;
    request.set(rhox::kKeyDetails, Object(true));
    Object reply;
    rhox::client::PerformCommand(manager, rhox::kCommandStatus, request, reply);
    const Object* list = reply.asDictionary() == nullptr ? nullptr : reply.asDictionary()->find(rhox::kKeyClients);
    return list == nullptr ? ipc::Array{} : *list->asArray();
  }

  std::shared_ptr<rhox::client::Manager> manager;

 private:
  const std::int64_t application_;
  std::shared_ptr<dispatch::SerialQueue> queue_ = std::make_shared<dispatch::SerialQueue>("client");
  std::mutex mutex_;
  std::vector<std::int64_t> metrics_;
};

TEST(RhoxdService, IsStartedByTheFirstViewerThatAsksForIt) {
  const ServiceBus bus(serviceCommand());
  ASSERT_EQ(bus.managerProcess(), 0);
  Process screen(viewer, {"--ui", "none", "--manager", "system"});
  EXPECT_TRUE(screen.waitForOutput("Received RSRP RSRQ SINR")) << screen.errors();
  EXPECT_GT(bus.managerProcess(), 0);
  screen.signal(SIGTERM);
  EXPECT_EQ(screen.wait(), (ProcessEnd{false, 0}));
}

TEST(RhoxdService, GivesEachClientWhatItAskedForAndNothingElse) {
  const ServiceBus bus(serviceCommand());
  Client one(11);
  Client other(12);
  EXPECT_EQ(one.listen("K_LTE_RSRP_RSRQ_SINR").message, "");
  EXPECT_EQ(other.listen("K_LTE_TX_POWER").message, "");
  ASSERT_TRUE(one.waitForMetrics(20));
  ASSERT_TRUE(other.waitForMetrics(20));
  EXPECT_EQ(connectionStatus(one.manager).sourceLabel, connectionStatus(other.manager).sourceLabel);
  const std::int64_t first = one.metrics().front();
  const std::int64_t second = other.metrics().front();
  EXPECT_NE(first, second);
  EXPECT_THAT(one.metrics(), Each(first));
  EXPECT_THAT(other.metrics(), Each(second));
  // Each has its own sequence without gaps.
  EXPECT_EQ(connectionStatus(one.manager).eventsLost, 0U);
  EXPECT_EQ(connectionStatus(other.manager).eventsLost, 0U);
}

TEST(RhoxdService, ForgetsAClientThatLeavesTheBus) {
  const ServiceBus bus(serviceCommand());
  Client stays(11);
  EXPECT_EQ(stays.listen("K_LTE_RSRP_RSRQ_SINR").message, "");
  {
    Client leaves(12);
    EXPECT_EQ(leaves.listen("K_LTE_TX_POWER").message, "");
    EXPECT_EQ(stays.clients().size(), 2U);
  }
  EXPECT_TRUE(eventually([&] { return stays.clients().size() == 1; }));
}

TEST(RhoxdService, KilledUnderLoadIsRestartedAndTheViewerHasLiveValuesWithinTwoSeconds) {
  const TemporaryFolder state;
  const ServiceBus bus(serviceCommand(state.path()));
  Process screen(viewer, {"--ui", "none", "--manager", "system"});
  ASSERT_TRUE(screen.waitForOutput("Received RSRP RSRQ SINR")) << screen.errors();
  const pid_t first = bus.managerProcess();
  ASSERT_EQ(::kill(first, SIGKILL), 0);
  const auto killed = std::chrono::steady_clock::now();
  ASSERT_TRUE(eventually([&] { return bus.managerProcess() != first && bus.managerProcess() != 0; }));
  const std::size_t before = screen.output().size();
  // The second manager's drive starts from the beginning, with the values that are reported only there: these values
  // are live.
  EXPECT_TRUE(screen.waitForOutput("Received SIM Card File Info", before));
  EXPECT_TRUE(screen.waitForOutput("Received RSRP RSRQ SINR", before));
  const auto passed = std::chrono::steady_clock::now() - killed;
  RecordProperty("milliseconds",
                 static_cast<int>(std::chrono::duration_cast<std::chrono::milliseconds>(passed).count()));
  EXPECT_LT(passed, 2s);
  screen.signal(SIGTERM);
  EXPECT_EQ(screen.wait(), (ProcessEnd{false, 0}));
}

TEST(RhoxdService, ThatIsStartedByHandIsFoundByAClientThatWaitsForIt) {
  const ServiceBus bus;
  Client client(11);
  const auto missing = client.listen("K_LTE_TX_POWER");
  EXPECT_NE(missing.status, 0);
  EXPECT_THAT(missing.message, HasSubstr("no manager on the system bus: "));
  EXPECT_TRUE(eventually(
      [&] { return connectionStatus(client.manager).problem.starts_with("no manager on the system bus: "); }));
  Process daemon(daemonProgram, serviceArguments());
  ASSERT_TRUE(daemon.waitForOutput("on the system bus")) << daemon.errors();
  ASSERT_TRUE(eventually([&] { return connectionStatus(client.manager).connected; }));
  EXPECT_EQ(client.listen("K_LTE_TX_POWER").message, "");
  EXPECT_TRUE(client.waitForMetrics(1));
}

TEST(RhoxdService, EndsWithTheBusSoThatItIsStartedAgain) {
  ServiceBus bus;
  Process daemon(daemonProgram, serviceArguments());
  ASSERT_TRUE(daemon.waitForOutput("on the system bus")) << daemon.errors();
  bus.stop();
  EXPECT_EQ(daemon.wait(), (ProcessEnd{false, 1}));
  EXPECT_THAT(daemon.errors(), HasSubstr("rhoxd: the system bus has closed the connection\n"));
}

TEST(RhoxdService, IsOnlyOnce) {
  const ServiceBus bus;
  Process first(daemonProgram, serviceArguments());
  ASSERT_TRUE(first.waitForOutput("on the system bus")) << first.errors();
  Process second(daemonProgram, serviceArguments());
  EXPECT_EQ(second.wait(), (ProcessEnd{false, 1}));
  EXPECT_EQ(second.errors(), "rhoxd: another manager has the name org.vespscope.BasebandManager1 on the system bus\n");
}

// The permitted users of the service.
class RhoxdServiceAccess : public ::testing::Test {
 protected:
  void SetUp() override {
    if (::geteuid() != 0) GTEST_SKIP() << "only the administrator can act as other users";
    groupNumber = ::getgrnam(ServiceBus::group)->gr_gid;
  }
  gid_t groupNumber = 0;
};

TEST_F(RhoxdServiceAccess, IsRefusedToOtherUsersByTheBusPolicy) {
  const ServiceBus bus(serviceCommand());
  // This user cannot even start it.
  EXPECT_EQ(asUser(nobody, {}, [] { return BusStranger().callManager("EventsOn"); }), denied);
  EXPECT_EQ(bus.managerProcess(), 0);
  Client client(11);
  EXPECT_EQ(client.listen("K_LTE_RSRP_RSRQ_SINR").message, "");
  ASSERT_TRUE(client.waitForMetrics(1));
  for (const char* method : {"EventsOn", "EventsOff", "PerformCommand"}) {
    EXPECT_EQ(asUser(nobody, {}, [method] { return BusStranger().callManager(method); }), denied) << method;
  }
  EXPECT_EQ(asUser(nobody, {}, [] { return BusStranger().introspectManager(); }), denied);
  EXPECT_EQ(asUser(nobody, {}, [] { return BusStranger().takeName(); }), "Permission denied");
  EXPECT_EQ(client.clients().size(), 1U);
}

TEST_F(RhoxdServiceAccess, LetsNobodyOverhearTheEventsOfAnother) {
  const ServiceBus bus(serviceCommand());
  Client client(11);
  EXPECT_EQ(client.listen("K_LTE_RSRP_RSRQ_SINR").message, "");
  ASSERT_TRUE(client.waitForMetrics(1));
  const std::size_t before = client.metrics().size();
  EXPECT_EQ(asUser(nobody, {}, [] { return std::to_string(BusStranger().overhear(1000ms)); }), "0");
  EXPECT_GT(client.metrics().size(), before);
  EXPECT_EQ(asUser(nobody, {}, [] { return BusStranger().becomeMonitor(); }), denied);
}

TEST_F(RhoxdServiceAccess, TakesNoEventsFromAnyoneButTheManager) {
  const ServiceBus bus(serviceCommand());
  Client client(11);
  EXPECT_EQ(client.listen("K_LTE_RSRP_RSRQ_SINR").message, "");
  ASSERT_TRUE(client.waitForMetrics(1));
  const std::string name = *client.clients().front().asDictionary()->find(rhox::kKeyBusName)->asString();
  EXPECT_EQ(asUser(nobody, {}, [&] { return BusStranger().forgeEvent(name) ? std::string("sent") : "not sent"; }),
            "sent");
  ASSERT_TRUE(client.waitForMetrics(client.metrics().size() + 5));
  EXPECT_THAT(client.metrics(), Not(::testing::Contains(666)));
}

TEST_F(RhoxdServiceAccess, IsGrantedToMembersOfItsGroup) {
  const ServiceBus bus(serviceCommand());
  EXPECT_EQ(asUser(nobody, {groupNumber}, [] { return BusStranger().callManager("EventsOn"); }), "");
  EXPECT_EQ(asUser(nobody, {groupNumber}, [] { return BusStranger().callManager("PerformCommand"); }), "");
  EXPECT_EQ(asUser(nobody, {groupNumber}, [] { return BusStranger().introspectManager(); }), "");
}

TEST_F(RhoxdServiceAccess, IsRefusedByTheManagerItselfWhereThePolicyLetsTooManyIn) {
  // The policy's group differs from the manager's: the group that the installation makes does not exist on this
  // machine, or is empty.
  std::vector<std::string> arguments = serviceArguments();
  arguments.back() = "no-such-group";
  const ServiceBus bus;
  Process daemon(daemonProgram, arguments);
  ASSERT_TRUE(daemon.waitForOutput("on the system bus")) << daemon.errors();
  EXPECT_EQ(asUser(nobody, {groupNumber}, [] { return BusStranger().callManager("EventsOn"); }), denied);
  EXPECT_EQ(asUser(nobody, {groupNumber}, [] { return BusStranger().callManager("PerformCommand"); }), denied);
  EXPECT_EQ(BusStranger().callManager("EventsOn"), "");
}

TEST_F(RhoxdServiceAccess, ARefusedViewerReportsWhy) {
  const ServiceBus bus(serviceCommand());
  const std::string problem = asUser(nobody, {}, [] {
    rhox::client::setAddress(*rhox::client::Address::parse("system"));
    const auto manager = rhox::client::CreateManager("client", nullptr);
    Object reply;
    return rhox::client::PerformCommand(manager, rhox::kCommandStatus, {}, reply).message;
  });
  EXPECT_THAT(problem, HasSubstr("the system bus denies this user access to the manager (is the user in its group?)"));
}

}  // namespace
}  // namespace vespscope::test
