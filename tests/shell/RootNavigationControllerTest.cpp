// The start of the flow of metrics, through the real client library and a manager.
#include <algorithm>
#include <cstdlib>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "client/RhoxWrapper.h"
#include "metrics/MetricValidator.h"
#include "platform/log/Log.h"
#include "rhoxlink/Rhoxlink.h"
#include "shell/RootNavigationController.h"
#include "support/FakeManager.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using Lines = std::vector<std::string>;

constexpr const char* configurationText = "report = [\"K_LTE_RRC_STATE\"]\n";

// The lines of one log channel.
class ChannelLines {
 public:
  explicit ChannelLines(log::Channel wanted)
      : observation_([this, wanted](log::Channel channel, std::string_view line) {
          const std::lock_guard lock(mutex_);
          if (channel == wanted) lines_.emplace_back(line);
        }) {}

  [[nodiscard]] Lines lines() {
    const std::lock_guard lock(mutex_);
    return lines_;
  }

 private:
  std::mutex mutex_;
  Lines lines_;
  log::Observation observation_;
};

// A root controller whose references a test may clear.
class OpenRoot : public RootNavigationController {
 public:
  using RootNavigationController::RootNavigationController;
  void dropWrapper() { myRhoxWrapper_ = nullptr; }
};

class RootNavigationControllerStart : public ::testing::Test {
 protected:
  RootNavigationControllerStart() {
    ::setenv("VESPSCOPE_RESOURCES", folder_.path().c_str(), 1);
    rhox::client::setAddress(rhox::client::Address::parse(manager_.address()).value());
  }

  void shipConfiguration() const { folder_.write("ice_test_lte.deviceconfig", configurationText); }

  // The controller, whose creation has listened once; the calls of that are removed.
  std::shared_ptr<OpenRoot> makeRoot() {
    auto root = std::make_shared<OpenRoot>(application::BarClasses{});
    EXPECT_TRUE(manager_.waitForConnections(1));
    EXPECT_TRUE(manager_.waitForCalls(2));
    EXPECT_EQ(manager_.callNames(), (Lines{"EventsOff", "EventsOn"}));
    return root;
  }

  // Returns the calls made by loading the controller, once `count` of them have arrived.
  std::vector<FakeManager::Call> callsOfLoading(RootNavigationController& root, std::size_t count) {
    root.loadViewIfNeeded();
    EXPECT_TRUE(manager_.waitForCalls(2 + count));
    auto calls = manager_.calls();
    calls.erase(calls.begin(), calls.begin() + 2);
    return calls;
  }

  TemporaryFolder folder_;
  FakeManager manager_{folder_ / "manager.socket"};
  ChannelLines output_{log::Channel::standardOutput};
  ChannelLines systemLog_{log::Channel::systemLog};
};

Lines namesOf(const std::vector<FakeManager::Call>& calls) {
  Lines names;
  for (const auto& call : calls) names.push_back(call.command.empty() ? call.method : call.command);
  return names;
}

std::vector<std::pair<std::string, std::int64_t>> integersOf(const ipc::Dictionary& request) {
  std::vector<std::pair<std::string, std::int64_t>> integers;
  for (const auto& [key, object] : request.entries()) {
    if (object.asInt64() != nullptr) integers.emplace_back(key, *object.asInt64());
  }
  return integers;
}

TEST_F(RootNavigationControllerStart, RemovesAddsListensAndQueriesInThisOrder) {
  shipConfiguration();
  const auto root = makeRoot();
  const auto calls = callsOfLoading(*root, 5);
  ASSERT_EQ(namesOf(calls), (Lines{"ClearConfiguration", "AddConfiguration", "EventsOff", "EventsOn", "QueryMetric"}));
  EXPECT_EQ(output_.lines(), (Lines{"pushing metric file", "Querying SIM files"}));

  const ipc::Object* payload = calls[1].request.find("kKeyPayload");
  ASSERT_TRUE(payload != nullptr && payload->asData() != nullptr);
  EXPECT_EQ(std::string(payload->asData()->begin(), payload->asData()->end()), configurationText);
  const std::vector<std::pair<std::string, std::int64_t>> query = {
      {"kKeyAppID", 2},           {"kKeyPayloadType", 0}, {"kKeyTriggerRef", 9999}, {"kKeyTriggerType", 0},
      {"kKeyTriggerID", 8323091}, {"kKeyProfileID", 0},   {"kKeyMetricID", 0}};
  EXPECT_EQ(integersOf(calls[4].request), query);
}

TEST_F(RootNavigationControllerStart, LogsEachCommandAndListeningOnTheSystemLog) {
  shipConfiguration();
  const auto root = makeRoot();
  callsOfLoading(*root, 5);
  const std::string query = "querySpecificMetric:triggerRef:triggerType:triggerID:profileID:metricID:";
  EXPECT_EQ(
      systemLog_.lines(),
      (Lines{"-[RhoxWrapper listen]: listening for events", "-[RhoxWrapper removeOrblConfigForAppid:]: error=0 msg=",
             "-[RhoxWrapper addOrblConfigForAppId:andProtofFilePath:]: error=0 msg=",
             "-[RhoxWrapper listen]: listening for events", "-[RhoxWrapper " + query + "]: error=0 msg="}));
}

TEST_F(RootNavigationControllerStart, WithoutTheResourceSaysSoAndOnlyRemoves) {
  const auto root = makeRoot();
  EXPECT_EQ(namesOf(callsOfLoading(*root, 1)), Lines{"ClearConfiguration"});
  EXPECT_EQ(output_.lines(), Lines{"Metric Log File path doesnt exist"});
}

TEST_F(RootNavigationControllerStart, AfterARefusedConfigurationNeitherListensNorQueries) {
  shipConfiguration();
  manager_.answer("AddConfiguration", {.status = 22, .message = "line 1: no such metric"});
  const auto root = makeRoot();
  EXPECT_EQ(namesOf(callsOfLoading(*root, 2)), (Lines{"ClearConfiguration", "AddConfiguration"}));
  EXPECT_EQ(output_.lines(), Lines{"pushing metric file"});
  EXPECT_EQ(systemLog_.lines().back(),
            "-[RhoxWrapper addOrblConfigForAppId:andProtofFilePath:]: error=22 msg=line 1: no such metric");
}

TEST_F(RootNavigationControllerStart, ContinuesWhenRemovingIsRefused) {
  shipConfiguration();
  manager_.answer("ClearConfiguration", {.status = 5, .message = "nothing to clear"});
  const auto root = makeRoot();
  callsOfLoading(*root, 5);
  EXPECT_EQ(output_.lines(), (Lines{"pushing metric file", "Querying SIM files"}));
}

TEST_F(RootNavigationControllerStart, IgnoresThatTheQueryIsRefused) {
  shipConfiguration();
  manager_.answer("QueryMetric", {.status = 7, .message = "no SIM"});
  const auto root = makeRoot();
  callsOfLoading(*root, 5);
  EXPECT_EQ(output_.lines(), (Lines{"pushing metric file", "Querying SIM files"}));
}

TEST_F(RootNavigationControllerStart, WithoutADecodersWrapperDoesNotListenAgain) {
  shipConfiguration();
  const auto root = makeRoot();
  MetricValidator::shared()->mySharedRhoxInstance = nullptr;
  EXPECT_EQ(namesOf(callsOfLoading(*root, 3)), (Lines{"ClearConfiguration", "AddConfiguration", "QueryMetric"}));
}

TEST_F(RootNavigationControllerStart, WithoutAWrapperAndWithoutTheResourceRunsOn) {
  const auto root = makeRoot();
  root->dropWrapper();
  root->loadViewIfNeeded();
  EXPECT_EQ(output_.lines(), Lines{"Metric Log File path doesnt exist"});
  EXPECT_EQ(manager_.calls().size(), 2U);
}

using RootNavigationControllerStartDeathTest = RootNavigationControllerStart;

TEST_F(RootNavigationControllerStartDeathTest, WithoutAWrapperPushingIsAProgrammingError) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");  // the connection has threads
  shipConfiguration();
  EXPECT_DEATH(
      {
        OpenRoot root{application::BarClasses{}};
        root.dropWrapper();
        root.loadViewIfNeeded();
      },
      "fatal: there is no wrapper to push the metric configuration through");
}

class RootNavigationControllerInitialisers : public ::testing::Test {
 protected:
  static void expectDefaults(const RootNavigationController& root) {
    EXPECT_EQ(root.myAppID(), "vespscope");
    EXPECT_EQ(root.metricFileName(), "ice_test_lte");
    EXPECT_EQ(root.metricFileType(), "deviceconfig");
    EXPECT_EQ(root.myRhoxWrapper(), RhoxWrapper::sharedInstance());
    EXPECT_EQ(root.myMetricValidator(), MetricValidator::shared());
    EXPECT_EQ(root.myMetricValidator()->mySharedRhoxInstance, root.myRhoxWrapper());
    EXPECT_EQ(root.myRhoxWrapper()->delegate(), root.myMetricValidator());
  }
  RootNavigationControllerInitialisers() { rhox::client::setAddress({rhox::client::Address::Kind::none, {}}); }
};

TEST_F(RootNavigationControllerInitialisers, WithARootScreenSetsTheDefaults) {
  const auto screen = std::make_shared<application::ViewController>();
  const RootNavigationController root(screen);
  expectDefaults(root);
  EXPECT_EQ(root.topViewController(), screen);
}

TEST_F(RootNavigationControllerInitialisers, WithBarClassesSetsTheDefaults) {
  const RootNavigationController root(application::BarClasses{"Top", "Bottom"});
  expectDefaults(root);
  EXPECT_EQ(root.bars().navigationBar, "Top");
}

TEST_F(RootNavigationControllerInitialisers, WithAResourceNameSetsTheDefaults) {
  const RootNavigationController root("Main", nullptr);
  expectDefaults(root);
  EXPECT_EQ(root.resourceName(), "Main");
}

TEST_F(RootNavigationControllerInitialisers, ListenOnceHoweverManyControllersAreMade) {
  ChannelLines systemLog{log::Channel::systemLog};
  const RootNavigationController first("Main", nullptr);
  const RootNavigationController second("Main", nullptr);
  expectDefaults(first);
  expectDefaults(second);
  EXPECT_EQ(systemLog.lines(), Lines{"-[RhoxWrapper listen]: listening for events"});
}

TEST_F(RootNavigationControllerInitialisers, AMemoryWarningChangesNothing) {
  RootNavigationController root("Main", nullptr);
  root.didReceiveMemoryWarning();
  expectDefaults(root);
}

}  // namespace
}  // namespace vespscope::test
