// Tasks, timers and descriptors of the main loop.
#include <poll.h>
#include <unistd.h>

#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "platform/dispatch/MainLoop.h"
#include "platform/dispatch/SerialQueue.h"

namespace vespscope::test {
namespace {

using namespace dispatch;
using std::chrono::milliseconds;

TEST(MainLoop, RunsTasksOfOtherThreadsInOrder) {
  MainLoop loop;
  std::vector<int> order;
  std::thread other([&loop, &order] {
    for (int task = 0; task < 10; ++task) loop.async([&order, task] { order.push_back(task); });
    loop.async([&loop] { loop.stop(3); });
  });
  EXPECT_EQ(loop.run(), 3);
  other.join();
  EXPECT_EQ(order, (std::vector<int>{0, 1, 2, 3, 4, 5, 6, 7, 8, 9}));
}

TEST(MainLoop, ATaskSubmittedByATaskRunsInTheNextRound) {
  MainLoop loop;
  int rounds = 0;
  loop.async([&] {
    ++rounds;
    loop.async([&rounds] { ++rounds; });
  });
  EXPECT_TRUE(loop.runOnce(milliseconds(0)));
  EXPECT_EQ(rounds, 1);
  EXPECT_TRUE(loop.runOnce(milliseconds(0)));
  EXPECT_EQ(rounds, 2);
  EXPECT_FALSE(loop.runOnce(milliseconds(0)));
}

TEST(MainLoop, ARepeatingTimerFiresAfterEachInterval) {
  MainLoop loop;
  int fired = 0;
  loop.scheduleRepeating(milliseconds(5000), [&fired] { ++fired; });
  loop.runOnce(milliseconds(0));
  EXPECT_EQ(fired, 0);
  loop.advance(milliseconds(4900));
  loop.runOnce(milliseconds(0));
  EXPECT_EQ(fired, 0);
  loop.advance(milliseconds(100));
  loop.runOnce(milliseconds(50));
  EXPECT_EQ(fired, 1);
  loop.advance(milliseconds(5000));
  loop.runOnce(milliseconds(50));
  EXPECT_EQ(fired, 2);
}

TEST(MainLoop, ATimerThatMissedIntervalsFiresOnce) {
  MainLoop loop;
  int fired = 0;
  loop.scheduleRepeating(milliseconds(1000), [&fired] { ++fired; });
  loop.advance(milliseconds(10500));
  loop.runOnce(milliseconds(50));
  EXPECT_EQ(fired, 1);
}

TEST(MainLoop, ATimerMayCancelItselfAndOthers) {
  MainLoop loop;
  int fired = 0;
  MainLoop::TimerIdentifier one = 0;
  MainLoop::TimerIdentifier other = 0;
  one = loop.scheduleRepeating(milliseconds(10), [&] {
    ++fired;
    loop.cancel(one);
    loop.cancel(other);
  });
  other = loop.scheduleRepeating(milliseconds(10), [&fired] { fired += 100; });
  loop.advance(milliseconds(20));
  loop.runOnce(milliseconds(50));
  EXPECT_EQ(fired, 1);
  EXPECT_EQ(loop.timerCount(), 0U);
}

TEST(MainLoop, WakesForARealTimer) {
  MainLoop loop;
  int fired = 0;
  loop.scheduleRepeating(milliseconds(20), [&fired] { ++fired; });
  EXPECT_TRUE(loop.runOnce(milliseconds(5000)));
  EXPECT_EQ(fired, 1);
}

TEST(MainLoop, CallsTheWatcherOfAReadableDescriptor) {
  MainLoop loop;
  int ends[2];
  ASSERT_EQ(::pipe(ends), 0);
  int called = 0;
  loop.watch(ends[0], [&] {
    ++called;
    loop.unwatch(ends[0]);
  });
  EXPECT_FALSE(loop.runOnce(milliseconds(0)));
  ASSERT_EQ(::write(ends[1], "x", 1), 1);
  EXPECT_TRUE(loop.runOnce(milliseconds(1000)));
  EXPECT_FALSE(loop.runOnce(milliseconds(0)));
  EXPECT_EQ(called, 1);
  ::close(ends[0]);
  ::close(ends[1]);
}

TEST(MainLoop, ItsDescriptorBecomesReadableWhenThereIsWork) {
  MainLoop loop;
  pollfd ready{loop.descriptor(), POLLIN, 0};
  EXPECT_EQ(::poll(&ready, 1, 0), 0);
  loop.async([] {});
  EXPECT_EQ(::poll(&ready, 1, 1000), 1);
  loop.runOnce(milliseconds(0));
  EXPECT_EQ(::poll(&ready, 1, 0), 0);
}

}  // namespace
}  // namespace vespscope::test
