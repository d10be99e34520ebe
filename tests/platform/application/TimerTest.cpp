// Timers keep their target until they are cancelled.
#include <chrono>
#include <memory>
#include <utility>

#include <gtest/gtest.h>

#include "platform/application/Timer.h"
#include "platform/dispatch/MainLoop.h"

namespace vespscope::test {
namespace {

using namespace application;

struct Target {
  void update() { ++updates; }
  int updates = 0;
};

TEST(Timer, ATimerKeepsItsTargetAliveUntilItIsCancelled) {
  auto& loop = dispatch::MainLoop::main();
  auto target = std::make_shared<Target>();
  const std::weak_ptr<Target> watch = target;
  const auto timer = scheduleTimer(std::chrono::milliseconds(5000), std::move(target), &Target::update);
  loop.advance(std::chrono::milliseconds(4999));
  loop.runOnce(std::chrono::milliseconds(0));
  ASSERT_FALSE(watch.expired());
  EXPECT_EQ(watch.lock()->updates, 0);
  loop.advance(std::chrono::milliseconds(1));
  loop.runOnce(std::chrono::milliseconds(0));
  EXPECT_EQ(watch.lock()->updates, 1);
  loop.cancel(timer);
  EXPECT_TRUE(watch.expired());
}

}  // namespace
}  // namespace vespscope::test
