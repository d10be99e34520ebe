// The application delegate answers and does nothing else.
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

}  // namespace
}  // namespace vespscope::test
