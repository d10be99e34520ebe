// Tasks that a thread hands to a loop together.
#include <thread>

#include <gtest/gtest.h>

#include "platform/dispatch/MainLoop.h"
#include "platform/dispatch/SerialQueue.h"

namespace vespscope::test {
namespace {

using namespace dispatch;
using std::chrono::milliseconds;

TEST(TaskBatch, HandsItsThreadsTasksOverTogetherInTheirOrder) {
  MainLoop loop;
  std::string order;
  {
    const TaskBatch batch(loop);
    loop.async([&order] { order += 'a'; });
    loop.async([&order] { order += 'b'; });
    std::thread([&] { loop.async([&order] { order += 'x'; }); }).join();
    loop.drain();
    EXPECT_EQ(order, "x");
  }
  loop.async([&order] { order += 'c'; });
  EXPECT_TRUE(loop.runOnce(std::chrono::milliseconds(0))) << "the loop was not woken";
  EXPECT_EQ(order, "xabc");
}

TEST(TaskBatch, LeavesTheTasksOfOtherLoopsAlone) {
  MainLoop loop;
  MainLoop other;
  bool ran = false;
  const TaskBatch batch(loop);
  other.async([&ran] { ran = true; });
  other.drain();
  EXPECT_TRUE(ran);
}

}  // namespace
}  // namespace vespscope::test
