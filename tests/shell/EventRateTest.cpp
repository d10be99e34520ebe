// Events per second over the last five seconds.
#include <gtest/gtest.h>

#include "shell/EventRate.h"

namespace vespscope::test {
namespace {

using std::chrono::milliseconds;
using std::chrono::seconds;

constexpr EventRate::Clock::time_point start{seconds(1000)};

TEST(EventRate, IsZeroWithoutAnEarlierCount) {
  EventRate rate;
  EXPECT_EQ(rate.update(start, 500), 0);
  EXPECT_EQ(rate.update(start, 500), 0);
}

TEST(EventRate, CountsSinceTheOldestSampleOfFiveSeconds) {
  EventRate rate;
  rate.update(start, 100);
  EXPECT_DOUBLE_EQ(rate.update(start + seconds(1), 150), 50);
  EXPECT_DOUBLE_EQ(rate.update(start + seconds(5), 200), 20);
  // The first sample is too old: 50 events since the second one.
  EXPECT_DOUBLE_EQ(rate.update(start + seconds(6), 200), 10);
}

TEST(EventRate, FallsToZeroWhenNothingComes) {
  EventRate rate;
  for (int second = 0; second < 6; ++second) rate.update(start + seconds(second), 60);
  EXPECT_EQ(rate.update(start + seconds(6), 60), 0);
}

TEST(EventRate, AfterAPauseStartsAgain) {
  EventRate rate;
  rate.update(start, 0);
  EXPECT_EQ(rate.update(start + seconds(60), 1000), 0);
  EXPECT_DOUBLE_EQ(rate.update(start + seconds(61), 1010), 10);
}

TEST(EventRate, AskedOftenIsAsExact) {
  EventRate rate;
  double last = 0;
  for (int step = 0; step <= 10000; ++step) {
    last = rate.update(start + milliseconds(step), static_cast<std::uint64_t>(step / 10));
  }
  EXPECT_NEAR(last, 100, 1);
}

}  // namespace
}  // namespace vespscope::test
