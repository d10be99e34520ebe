// The facts for the status line while the whole application runs.
#include <chrono>
#include <cstdlib>
#include <functional>
#include <memory>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "client/RhoxWrapper.h"
#include "metrics/MetricValidator.h"
#include "platform/application/TableSnapshot.h"
#include "platform/dispatch/MainLoop.h"
#include "registry/MetricRows.h"
#include "rhoxlink/Rhoxlink.h"
#include "screens/FirstLevelViewController.h"
#include "screens/SecondLevelViewController.h"
#include "screens/ThirdLevelViewController.h"
#include "screens/VespViewController.h"
#include "shell/AppDelegate.h"
#include "shell/ConnectionFacts.h"
#include "shell/MainInterface.h"
#include "shell/RootNavigationController.h"
#include "shell/ScreenAges.h"
#include "support/FakeManager.h"
#include "support/ScriptedRun.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using application::NavigationController;
using application::readTable;
using application::TableViewController;
using dispatch::MainLoop;

std::shared_ptr<TableViewController> top(const NavigationController& navigation) {
  return std::dynamic_pointer_cast<TableViewController>(navigation.topViewController());
}

// Runs the main loop until `condition` holds; returns false on a timeout.
bool runUntil(const std::function<bool()>& condition) {
  const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(5);
  while (!condition()) {
    if (std::chrono::steady_clock::now() > end) return false;
    MainLoop::main().runOnce(std::chrono::milliseconds(20));
  }
  return true;
}

// Runs a test's steps in place of an interface.
class Steps : public application::Frontend {
 public:
  explicit Steps(std::function<void(application::Application&)> steps) : steps_(std::move(steps)) {}
  int run(application::Application& application) override {
    steps_(application);
    return 0;
  }

 private:
  std::function<void(application::Application&)> steps_;
};

class ConnectionFacts : public ::testing::Test {
 protected:
  ConnectionFacts() {
    ::setenv("TZ", "UTC", 1);
    folder_.write("ice_test_lte.deviceconfig", "any");
    ::setenv("VESPSCOPE_RESOURCES", folder_.path().c_str(), 1);
    rhox::client::setAddress(rhox::client::Address::parse(manager_.address()).value());
    manager_.setSource("drive.pcap", "recorded");
    application::registerDelegateClass("AppDelegate", [] { return std::make_unique<AppDelegate>(); });
  }

  void run(const std::function<void(application::Application&)>& steps) {
    application::Application application{.interface = mainInterface(),
                                         .navigation = nullptr,
                                         .status = statusProvider(),
                                         .screenAge = screenAgeProvider(),
                                         .showNextSim = {}};
    Steps frontend(steps);
    EXPECT_EQ(application::applicationMain({"vespscope"}, "AppDelegate", application, frontend), 0);
  }

  TemporaryFolder folder_;
  FakeManager manager_{folder_ / "manager.socket"};
};

TEST_F(ConnectionFacts, ShowsAnEventAtTheNextRefreshOfItsScreen) {
  run([this](application::Application& application) {
    auto& navigation = *application.navigation;
    navigation.selectRow(application.interface, top(navigation), {0, 1});  // LTE
    navigation.selectRow(application.interface, top(navigation), {0, 1});  // RRC State
    const auto screen = top(navigation);
    EXPECT_EQ(screen->numberOfRows(0), 0U);

    const MetricEvent event = scriptedRun().front();
    manager_.sendMetric(event.metricID, event.payload);
    ASSERT_TRUE(runUntil([] { return MetricValidator::shared()->myLTERRCStateDict.has_value(); }));
    EXPECT_EQ(screen->tableView().reloadCount(), 0U);
    MainLoop::main().advance(std::chrono::seconds(5));
    ASSERT_TRUE(runUntil([&screen] { return screen->tableView().reloadCount() == 1; }));
    const auto table = readTable(*screen);
    ASSERT_EQ(table.sections.at(0).rows.size(), 5U);
    EXPECT_EQ(table.sections[0].rows[1].label, "state");
    EXPECT_EQ(table.sections[0].rows[1].value, "KLTE_RRC_STATE_CONNECTED");
  });
}

TEST_F(ConnectionFacts, ReportTheStateOfTheConnection) {
  run([this](application::Application& application) {
    application::Status status = application.status();
    EXPECT_TRUE(status.connected);
    EXPECT_EQ(status.problem, "");
    EXPECT_EQ(status.kind, SourceKind::recorded);
    EXPECT_EQ(status.source, "drive.pcap");
    EXPECT_EQ(status.events, 0U);
    EXPECT_FALSE(status.lastEvent);

    const MetricEvent event = scriptedRun().front();
    manager_.sendMetric(event.metricID, event.payload);
    manager_.sendMetric(event.metricID, {0x08}, 0, 2);  // truncated, after a gap of two
    ASSERT_TRUE(runUntil([] { return MetricValidator::shared()->decodeFailures() == 1; }));
    status = application.status();
    EXPECT_EQ(status.events, 2U);
    EXPECT_EQ(status.eventsLost, 2U);
    EXPECT_EQ(status.decodeFailures, 1U);
    EXPECT_TRUE(status.lastEvent);
    EXPECT_GT(status.eventsPerSecond, 0.0);
  });
}

// One event for each metric of the scripted run that `wanted` selects, in order.
std::vector<MetricEvent> scripted(const std::vector<std::int32_t>& wanted) {
  std::vector<MetricEvent> events;
  for (const std::int32_t identifier : wanted) {
    for (const MetricEvent& event : scriptedRun()) {
      if (event.metricID == identifier) events.push_back(event);
    }
  }
  return events;
}

TEST_F(ConnectionFacts, KnowsHowOldEachScreenIsAndWhenItsTechnologyNoLongerServes) {
  run([this](application::Application& application) {
    auto& navigation = *application.navigation;
    EXPECT_FALSE(application.screenAge(*top(navigation)));                 // a list of screens shows no reports
    navigation.selectRow(application.interface, top(navigation), {0, 1});  // LTE
    EXPECT_FALSE(application.screenAge(*top(navigation)));
    navigation.selectRow(application.interface, top(navigation), {0, 2});  // Serving Cell Info
    const auto screen = top(navigation);
    ASSERT_TRUE(application.screenAge(*screen));
    EXPECT_EQ(application.screenAge(*screen)->age, std::nullopt);

    const auto& decoder = *MetricValidator::shared();
    const auto send = [this](const std::vector<MetricEvent>& events) {
      for (const MetricEvent& event : events) manager_.sendMetric(event.metricID, event.payload);
    };
    const auto lte = scripted({metricIdentifier("K_LTE_SCELL_INFO"), metricIdentifier("K_LTE_RSRP_RSRQ_SINR")});
    send(lte);
    ASSERT_TRUE(runUntil([&] { return decoder.myLTERsrpRsrqSinrDict.has_value(); }));
    // The manager plays a recording, so the age is computed from the reports' own times, not from their arrival.
    const auto between = lte.at(1).time - lte.at(0).time;
    EXPECT_EQ(application.screenAge(*screen)->age, between);
    EXPECT_FALSE(application.screenAge(*screen)->lastKnown);

    const auto umts = scripted({metricIdentifier("K_UMTS_SCELL_INFO")});
    send(umts);
    ASSERT_TRUE(runUntil([&] { return decoder.myUMTSCellInfoDict.has_value(); }));
    EXPECT_EQ(application.screenAge(*screen)->age, umts.at(0).time - lte.at(0).time);
    EXPECT_TRUE(application.screenAge(*screen)->lastKnown);
  });
}

struct SourceWord {
  std::string word;
  SourceKind kind;
};

class ConnectionFactsOfASource : public ConnectionFacts, public ::testing::WithParamInterface<SourceWord> {};

TEST_P(ConnectionFactsOfASource, IsShownAsWhatTheManagerCallsIt) {
  manager_.setSource("where it comes from", GetParam().word);
  run([](application::Application& application) {
    EXPECT_EQ(application.status().kind, GetParam().kind);
    EXPECT_EQ(application.status().source, "where it comes from");
  });
}

INSTANTIATE_TEST_SUITE_P(ConnectionFacts, ConnectionFactsOfASource,
                         ::testing::Values(SourceWord{"live", SourceKind::live},
                                           SourceWord{"simulated", SourceKind::simulated},
                                           SourceWord{"recorded", SourceKind::recorded},
                                           SourceWord{"guessed", SourceKind::unknown}),
                         [](const auto& tested) { return tested.param.word; });

TEST_F(ConnectionFacts, CountsTheGapThatAManagerLeavesThatWasLostAndIsBack) {
  run([this](application::Application& application) {
    EXPECT_EQ(application.status().interruptions, 0U);
    manager_.disconnect();
    ASSERT_TRUE(runUntil([&] { return application.status().interruptions == 1; }));
    ASSERT_TRUE(runUntil([&] { return application.status().connected; }));
    EXPECT_EQ(application.status().eventsLost, 0U);
  });
}

}  // namespace
}  // namespace vespscope::test
