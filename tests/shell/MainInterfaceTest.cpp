// The interface description: which screen leads to which.
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

namespace vespscope::test {
namespace {

using application::NavigationController;
using application::readTable;
using application::TableViewController;
using dispatch::MainLoop;

std::shared_ptr<TableViewController> top(const NavigationController& navigation) {
  return std::dynamic_pointer_cast<TableViewController>(navigation.topViewController());
}

void useNoManager() { rhox::client::setAddress({rhox::client::Address::Kind::none, {}}); }

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

}  // namespace
}  // namespace vespscope::test
