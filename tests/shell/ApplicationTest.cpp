// The application as a whole: its delegate, its scenes, and an event's road from a manager to a screen.
#include <chrono>
#include <cstdlib>
#include <functional>
#include <memory>
#include <string>

#include <gtest/gtest.h>

#include "client/RhoxWrapper.h"
#include "metrics/MetricValidator.h"
#include "platform/application/TableSnapshot.h"
#include "platform/dispatch/MainLoop.h"
#include "rhoxlink/Rhoxlink.h"
#include "screens/FirstLevelViewController.h"
#include "screens/SecondLevelViewController.h"
#include "screens/ThirdLevelViewController.h"
#include "screens/VespViewController.h"
#include "shell/AppDelegate.h"
#include "shell/ConnectionFacts.h"
#include "shell/MainInterface.h"
#include "shell/RootNavigationController.h"
#include "support/FakeManager.h"
#include "support/ScriptedRun.h"
#include "support/TemporaryFolder.h"

namespace vespscope {
namespace {

using application::NavigationController;
using application::readTable;
using application::TableViewController;
using dispatch::MainLoop;

std::shared_ptr<TableViewController> top(const NavigationController& navigation) {
  return std::dynamic_pointer_cast<TableViewController>(navigation.topViewController());
}

void useNoManager() { rhox::client::setAddress({rhox::client::Address::Kind::none, {}}); }

// Runs the main loop until `condition` holds; false when it does not in time.
bool runUntil(const std::function<bool()>& condition) {
  const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(5);
  while (!condition()) {
    if (std::chrono::steady_clock::now() > end) return false;
    MainLoop::main().runOnce(std::chrono::milliseconds(20));
  }
  return true;
}

TEST(AppDelegate, SaysThatLaunchingWentWellAndDoesNothingElse) {
  application::Application application;
  AppDelegate delegate;
  EXPECT_EQ(delegate.window(), nullptr);
  EXPECT_TRUE(delegate.didFinishLaunchingWithOptions(application, {}));
  delegate.applicationWillResignActive(application);
  delegate.applicationDidEnterBackground(application);
  delegate.applicationWillEnterForeground(application);
  delegate.applicationDidBecomeActive(application);
  delegate.applicationWillTerminate(application);
  EXPECT_EQ(delegate.window(), nullptr);
  EXPECT_EQ(application.navigation, nullptr);
}

TEST(AppDelegate, HoldsTheWindowItIsGiven) {
  AppDelegate delegate;
  const auto window = std::make_shared<application::Window>();
  delegate.setWindow(window);
  EXPECT_EQ(delegate.window(), window);
  delegate.setWindow(nullptr);
  EXPECT_EQ(delegate.window(), nullptr);
}

TEST(MainInterface, StartsWithTheLaunchScreenInTheRootController) {
  useNoManager();
  const auto navigation = mainInterface().instantiateInitial();
  EXPECT_NE(std::dynamic_pointer_cast<RootNavigationController>(navigation), nullptr);
  ASSERT_EQ(navigation->viewControllers().size(), 1U);
  EXPECT_NE(std::dynamic_pointer_cast<VespViewController>(navigation->topViewController()), nullptr);
  EXPECT_EQ(navigation->topViewController()->title(), "vespscope");
}

TEST(MainInterface, LeadsFromTheLaunchRowsToAScreen) {
  useNoManager();
  const auto interface = mainInterface();
  const auto navigation = interface.instantiateInitial();
  EXPECT_TRUE(readTable(*top(*navigation)).sections.at(0).rows.at(3).disclosure);

  ASSERT_TRUE(navigation->selectRow(interface, top(*navigation), {0, 3}));
  const auto list = std::dynamic_pointer_cast<FirstLevelViewController>(navigation->topViewController());
  ASSERT_NE(list, nullptr);
  EXPECT_EQ(list->title(), "GSM");
  EXPECT_EQ(list->seguedThroughRow, "GSM");
  EXPECT_TRUE(readTable(*list).sections.at(0).rows.at(2).disclosure);

  ASSERT_TRUE(navigation->selectRow(interface, list, {0, 2}));
  const auto screen = std::dynamic_pointer_cast<SecondLevelViewController>(navigation->topViewController());
  ASSERT_NE(screen, nullptr);
  EXPECT_EQ(screen->title(), "Serving Cell Info");
  EXPECT_EQ(screen->firstSelection, "GSM");
  EXPECT_EQ(screen->seguedThroughRow, "Serving Cell Info");
  EXPECT_EQ(MainLoop::main().timerCount(), 1U);
}

TEST(MainInterface, ASecondLevelRowLeadsNowhere) {
  useNoManager();
  const auto interface = mainInterface();
  const auto navigation = interface.instantiateInitial();
  navigation->selectRow(interface, top(*navigation), {0, 0});
  navigation->selectRow(interface, top(*navigation), {0, 0});
  EXPECT_FALSE(readTable(*top(*navigation)).sections.at(0).rows.at(0).disclosure);
  EXPECT_FALSE(navigation->selectRow(interface, top(*navigation), {0, 0}));
  EXPECT_EQ(navigation->viewControllers().size(), 3U);
}

TEST(MainInterface, HasAPlaceForTheDetailOfARow) {
  useNoManager();
  const auto screen = mainInterface().instantiate("thirdLevel");
  EXPECT_NE(std::dynamic_pointer_cast<ThirdLevelViewController>(screen), nullptr);
  const application::TableSnapshot expected = {{{std::nullopt, {{"", std::nullopt, false}}}}};
  EXPECT_EQ(readTable(*screen), expected);
}

// Runs a test's steps where an interface would draw.
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

class WholeApplication : public ::testing::Test {
 protected:
  WholeApplication() {
    ::setenv("TZ", "UTC", 1);
    folder_.write("ice_test_lte.deviceconfig", "any");
    ::setenv("VESPSCOPE_RESOURCES", folder_.path().c_str(), 1);
    rhox::client::setAddress(rhox::client::Address::parse(manager_.address()).value());
    manager_.setSource("drive.pcap", "recorded");
    application::registerDelegateClass("AppDelegate", [] { return std::make_unique<AppDelegate>(); });
  }

  void run(const std::function<void(application::Application&)>& steps) {
    application::Application application{
        .interface = mainInterface(), .navigation = nullptr, .status = statusProvider()};
    Steps frontend(steps);
    EXPECT_EQ(application::applicationMain({"vespscope"}, "AppDelegate", application, frontend), 0);
  }

  test::TemporaryFolder folder_;
  test::FakeManager manager_{folder_ / "manager.socket"};
};

TEST_F(WholeApplication, ShowsAnEventAtTheNextRefreshOfItsScreen) {
  run([this](application::Application& application) {
    auto& navigation = *application.navigation;
    navigation.selectRow(application.interface, top(navigation), {0, 1});  // LTE
    navigation.selectRow(application.interface, top(navigation), {0, 1});  // RRC State
    const auto screen = top(navigation);
    EXPECT_EQ(screen->numberOfRows(0), 0U);

    const MetricEvent event = testing::scriptedRun().front();
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

TEST_F(WholeApplication, TellsTheStateOfItsConnection) {
  run([this](application::Application& application) {
    application::Status status = application.status();
    EXPECT_TRUE(status.connected);
    EXPECT_EQ(status.problem, "");
    EXPECT_EQ(status.kind, SourceKind::recorded);
    EXPECT_EQ(status.source, "drive.pcap");
    EXPECT_EQ(status.events, 0U);
    EXPECT_FALSE(status.lastEvent);

    const MetricEvent event = testing::scriptedRun().front();
    manager_.sendMetric(event.metricID, event.payload);
    manager_.sendMetric(event.metricID, {0x08}, 0, 2);  // cut short, after a gap of two
    ASSERT_TRUE(runUntil([] { return MetricValidator::shared()->decodeFailures() == 1; }));
    status = application.status();
    EXPECT_EQ(status.events, 2U);
    EXPECT_EQ(status.eventsLost, 2U);
    EXPECT_EQ(status.decodeFailures, 1U);
    EXPECT_TRUE(status.lastEvent);
    EXPECT_GT(status.eventsPerSecond, 0.0);
  });
}

struct SourceWord {
  std::string word;
  SourceKind kind;
};

class ItsSource : public WholeApplication, public ::testing::WithParamInterface<SourceWord> {};

TEST_P(ItsSource, IsShownAsWhatTheManagerCallsIt) {
  manager_.setSource("where it comes from", GetParam().word);
  run([](application::Application& application) {
    EXPECT_EQ(application.status().kind, GetParam().kind);
    EXPECT_EQ(application.status().source, "where it comes from");
  });
}

INSTANTIATE_TEST_SUITE_P(WholeApplication, ItsSource,
                         ::testing::Values(SourceWord{"live", SourceKind::live},
                                           SourceWord{"simulated", SourceKind::simulated},
                                           SourceWord{"recorded", SourceKind::recorded},
                                           SourceWord{"guessed", SourceKind::unknown}),
                         [](const auto& tested) { return tested.param.word; });

TEST_F(WholeApplication, CountsTheGapThatAManagerLeavesThatWasLostAndIsBack) {
  run([this](application::Application& application) {
    EXPECT_EQ(application.status().interruptions, 0U);
    manager_.disconnect();
    ASSERT_TRUE(runUntil([&] { return application.status().interruptions == 1; }));
    ASSERT_TRUE(runUntil([&] { return application.status().connected; }));
    EXPECT_EQ(application.status().eventsLost, 0U);
  });
}

}  // namespace
}  // namespace vespscope
