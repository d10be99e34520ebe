// Watching descriptors from the main loop, and the operations allowed in callbacks.
#include <sys/eventfd.h>
#include <unistd.h>

#include <chrono>
#include <functional>
#include <numeric>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "platform/dispatch/MainLoop.h"
#include "platform/dispatch/SerialQueue.h"

namespace vespscope::test {
namespace {

using namespace dispatch;
using std::chrono::milliseconds;

class Counter {
 public:
  Counter() : descriptor_(::eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK)) {}
  Counter(const Counter&) = delete;
  Counter& operator=(const Counter&) = delete;
  ~Counter() { ::close(descriptor_); }
  [[nodiscard]] int descriptor() const { return descriptor_; }
  void makeReadable() const { ::eventfd_write(descriptor_, 1); }
  void empty() const {
    eventfd_t ignored = 0;
    ::eventfd_read(descriptor_, &ignored);
  }

 private:
  int descriptor_;
};

TEST(MainLoopWatch, AWatcherMayRemoveAnotherOneThatIsReadableToo) {
  MainLoop loop;
  const Counter one;
  const Counter other;
  int calls = 0;
  loop.watch(one.descriptor(), [&] {
    ++calls;
    one.empty();
    loop.unwatch(other.descriptor());
  });
  loop.watch(other.descriptor(), [&] {
    ++calls;
    other.empty();
    loop.unwatch(one.descriptor());
  });
  one.makeReadable();
  other.makeReadable();
  loop.runOnce(milliseconds(0));
  loop.runOnce(milliseconds(0));
  EXPECT_EQ(calls, 1);
}

TEST(MainLoopWatch, AWatcherMayAddAnotherOne) {
  MainLoop loop;
  const Counter one;
  const Counter other;
  std::vector<int> order;
  other.makeReadable();
  loop.watch(one.descriptor(), [&] {
    order.push_back(1);
    one.empty();
    loop.watch(other.descriptor(), [&] {
      order.push_back(2);
      other.empty();
    });
  });
  one.makeReadable();
  loop.runOnce(milliseconds(0));
  loop.runOnce(milliseconds(0));
  EXPECT_EQ(order, (std::vector<int>{1, 2}));
}

TEST(MainLoopWatch, AWatcherMayReplaceItself) {
  MainLoop loop;
  const Counter counter;
  std::vector<int> order;
  loop.watch(counter.descriptor(), [&, text = std::vector<int>(100, 7)] {
    loop.watch(counter.descriptor(), [&] {
      order.push_back(2);
      counter.empty();
    });
    order.push_back(text.at(99));  // the callback lives until it returns
  });
  counter.makeReadable();
  loop.runOnce(milliseconds(0));
  loop.runOnce(milliseconds(0));
  EXPECT_EQ(order, (std::vector<int>{7, 2}));
}

TEST(MainLoopWatch, AHungUpDescriptorIsReadable) {
  MainLoop loop;
  int ends[2];
  ASSERT_EQ(::pipe(ends), 0);
  int calls = 0;
  loop.watch(ends[0], [&] {
    ++calls;
    loop.unwatch(ends[0]);
  });
  ::close(ends[1]);
  EXPECT_TRUE(loop.runOnce(milliseconds(1000)));
  EXPECT_EQ(calls, 1);
  ::close(ends[0]);
}

TEST(MainLoopWatch, TasksThatKeepSubmittingDelayNoOthers) {
  MainLoop loop;
  const Counter counter;
  int rounds = 0;
  std::function<void()> again = [&] {
    ++rounds;
    loop.async(again);
  };
  bool called = false;
  loop.watch(counter.descriptor(), [&] {
    called = true;
    loop.unwatch(counter.descriptor());
  });
  int fired = 0;
  loop.scheduleRepeating(milliseconds(100), [&fired] { ++fired; });
  loop.async(again);
  counter.makeReadable();
  loop.advance(milliseconds(100));
  loop.runOnce(milliseconds(0));
  loop.runOnce(milliseconds(0));
  EXPECT_TRUE(called);
  EXPECT_EQ(fired, 1);
  EXPECT_EQ(rounds, 2);
}

TEST(MainLoopWatch, ManySlowTasksLeaveTimersAndDescriptorsTheirTurn) {
  MainLoop loop;
  const Counter counter;
  bool called = false;
  loop.watch(counter.descriptor(), [&] {
    called = true;
    counter.empty();
  });
  std::vector<int> order;
  for (int task = 0; task < 20; ++task) {
    loop.async([&order, task] {
      std::this_thread::sleep_for(milliseconds(5));
      order.push_back(task);
    });
  }
  loop.runOnce(milliseconds(0));
  EXPECT_FALSE(order.empty());
  EXPECT_LT(order.size(), 20U);
  counter.makeReadable();
  loop.runOnce(milliseconds(1000));
  EXPECT_TRUE(called);
  while (loop.runOnce(milliseconds(0))) {
  }
  std::vector<int> all(20);
  std::iota(all.begin(), all.end(), 0);
  EXPECT_EQ(order, all);
}

TEST(MainLoopWatch, DrainingRunsWhatIsQueuedAndNotWhatThatQueues) {
  MainLoop loop;
  std::vector<int> order;
  loop.async([&] {
    order.push_back(1);
    loop.async([&order] { order.push_back(3); });
  });
  loop.async([&order] { order.push_back(2); });
  loop.drain();
  EXPECT_EQ(order, (std::vector<int>{1, 2}));
  loop.drain();
  EXPECT_EQ(order, (std::vector<int>{1, 2, 3}));
}

TEST(MainLoopWatch, ATaskFromAQueueRunsOnTheLoopsThread) {
  MainLoop loop;
  SerialQueue queue("test.queue");
  std::thread::id ran;
  queue.async([&] {
    loop.async([&] {
      ran = std::this_thread::get_id();
      loop.stop(0);
    });
  });
  EXPECT_EQ(loop.run(), 0);
  EXPECT_EQ(ran, std::this_thread::get_id());
}

}  // namespace
}  // namespace vespscope::test
