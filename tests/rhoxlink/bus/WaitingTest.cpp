// A wait ends with the first of its descriptors or at its earliest time, and not before.
#include <unistd.h>

#include <chrono>
#include <thread>

#include <gtest/gtest.h>

#include "platform/dispatch/WakeDescriptor.h"
#include "rhoxlink/bus/Waiting.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using bus::Wait;
using bus::Waiting;

class WaitingFor : public testing::Test {
 protected:
  // The time that the wait took.
  std::chrono::nanoseconds wait() {
    const auto before = Waiting::Clock::now();
    waiting_.wait();
    return Waiting::Clock::now() - before;
  }

  Waiting waiting_;
  const dispatch::WakeDescriptor wake_;
};

TEST_F(WaitingFor, ADescriptorEndsWhenItIsReady) {
  waiting_.add(-1, POLLIN);
  waiting_.add(wake_.descriptor(), POLLIN);
  std::thread other([this] {
    std::this_thread::sleep_for(30ms);
    wake_.wake();
  });
  EXPECT_GE(wait(), 10ms);  // and not never
  other.join();
}

TEST_F(WaitingFor, TheEarliestOfSeveralTimesEndsThenAndNotBefore) {
  waiting_.atMost(10min);
  waiting_.until(Waiting::Clock::now() + 25ms);
  waiting_.add(Wait{.timeout = 5min});
  waiting_.add(wake_.descriptor(), POLLIN);
  const auto until = Waiting::Clock::now() + 20ms;
  wait();
  EXPECT_GE(Waiting::Clock::now(), until);
}

TEST_F(WaitingFor, ATimeThatHasPassedEndsAtOnce) {
  waiting_.atMost(10min);
  waiting_.until(Waiting::Clock::now() - 1s);
  EXPECT_LT(wait(), 5s);
}

TEST_F(WaitingFor, AnEndOfTheBusEndsWithItsOutputOrItsTime) {
  int ends[2];
  ASSERT_EQ(::pipe(ends), 0);
  Waiting writable;
  writable.add(Wait{.descriptor = ends[0], .events = POLLIN, .outputDescriptor = ends[1], .outputEvents = POLLOUT});
  writable.atMost(10min);
  const auto before = Waiting::Clock::now();
  writable.wait();
  EXPECT_LT(Waiting::Clock::now() - before, 5s);
  waiting_.add(Wait{.descriptor = ends[0], .events = POLLIN, .timeout = 15ms});
  EXPECT_GE(wait(), 15ms);
  ::close(ends[0]);
  ::close(ends[1]);
}

}  // namespace
}  // namespace vespscope::test
