// Serial queues run their tasks in order, on a thread of their own.
#include <atomic>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "platform/dispatch/MainLoop.h"
#include "platform/dispatch/SerialQueue.h"

namespace vespscope::test {
namespace {

using namespace dispatch;

TEST(SerialQueue, RunsTasksOneAtATimeInOrder) {
  SerialQueue queue("org.vespscope.test");
  std::vector<int> order;
  for (int task = 0; task < 100; ++task) queue.async([&order, task] { order.push_back(task); });
  queue.drain();
  ASSERT_EQ(order.size(), 100U);
  for (int task = 0; task < 100; ++task) EXPECT_EQ(order.at(static_cast<std::size_t>(task)), task);
  EXPECT_EQ(queue.label(), "org.vespscope.test");
}

TEST(SerialQueue, RunsTasksOffTheSubmittingThread) {
  SerialQueue queue("q");
  std::thread::id runner;
  queue.async([&runner] { runner = std::this_thread::get_id(); });
  queue.drain();
  EXPECT_NE(runner, std::this_thread::get_id());
}

TEST(SerialQueue, RunsWhatIsQueuedBeforeItEnds) {
  std::atomic<int> ran = 0;
  {
    SerialQueue queue("q");
    for (int task = 0; task < 50; ++task) queue.async([&ran] { ++ran; });
  }
  EXPECT_EQ(ran, 50);
}

TEST(SerialQueue, ATaskMaySubmitAnother) {
  std::atomic<bool> ran = false;
  {
    SerialQueue queue("q");
    queue.async([&queue, &ran] { queue.async([&ran] { ran = true; }); });
  }
  EXPECT_TRUE(ran);
}

TEST(SerialQueue, DrainingWaitsForWhatIsQueued) {
  SerialQueue queue("test.queue");
  int done = 0;
  for (int task = 0; task < 100; ++task) queue.async([&done] { ++done; });
  queue.drain();
  EXPECT_EQ(done, 100);
  EXPECT_EQ(queue.size(), 0U);
}

}  // namespace
}  // namespace vespscope::test
