// The main function: the delegate, the first screen and the frontend, in their order.
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include "Scenes.h"
#include "platform/application/Application.h"

namespace vespscope::test {
namespace {

using namespace application;

std::vector<std::string> steps;

class Delegate : public ApplicationDelegate {
 public:
  bool didFinishLaunchingWithOptions(Application& /*application*/, const std::vector<std::string>& options) override {
    steps.push_back("launched with " + options.at(0));
    return true;
  }
  void applicationWillResignActive(Application& /*application*/) override { steps.emplace_back("resign"); }
  void applicationDidEnterBackground(Application& /*application*/) override { steps.emplace_back("background"); }
  void applicationWillEnterForeground(Application& /*application*/) override { steps.emplace_back("foreground"); }
  void applicationDidBecomeActive(Application& /*application*/) override { steps.emplace_back("active"); }
  void applicationWillTerminate(Application& /*application*/) override { steps.emplace_back("terminate"); }
  [[nodiscard]] std::shared_ptr<Window> window() const override { return window_; }
  void setWindow(std::shared_ptr<Window> window) override { window_ = std::move(window); }

 private:
  std::shared_ptr<Window> window_;
};

class OneLook : public Frontend {
 public:
  int run(Application& application) override {
    steps.emplace_back("run");
    EXPECT_EQ(top(*application.navigation)->loads, 1);
    return 7;
  }
};

TEST(ApplicationMain, MakesTheDelegateAndTheFirstScreenAndRunsTheFrontend) {
  registerDelegateClass("Delegate", [] { return std::make_unique<Delegate>(); });
  Application application;
  application.interface = twoScenes("");
  OneLook frontend;
  EXPECT_EQ(applicationMain({"program"}, "Delegate", application, frontend), 7);
  EXPECT_EQ(steps, (std::vector<std::string>{"launched with program", "active", "run", "terminate"}));
}

TEST(ApplicationMain, AnUnknownDelegateClassIsAProgrammingError) {
  Application application;
  application.interface = twoScenes("");
  OneLook frontend;
  EXPECT_DEATH(applicationMain({"program"}, "NoSuchDelegate", application, frontend),
               "fatal: no application delegate class \"NoSuchDelegate\"");
}

}  // namespace
}  // namespace vespscope::test
