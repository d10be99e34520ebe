// A recording's own time.
#include <chrono>
#include <limits>
#include <stop_token>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "ListStream.h"
#include "sources/playback/RecordedTime.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using sources::RecordedTime;
using sources::saturatingDifference;
using sources::saturatingSum;
using std::chrono::nanoseconds;
using testing::ElementsAre;

TEST(RecordedTime, CountsFromTheFirstEventWithEverySilenceAsLongAsItWas) {
  RecordedTime time;
  EXPECT_FALSE(time.lastTime());
  std::vector<nanoseconds> positions;
  for (const nanoseconds event : {5s, 6s, 3606s, 3607s}) {
    time.advance(event);
    positions.push_back(time.position());
  }
  EXPECT_THAT(positions, ElementsAre(0s, 1s, 3601s, 3602s));
  EXPECT_EQ(time.lastTime(), 3607s);
}

TEST(RecordedTime, CountsTimeThatRunsBackwardsAsNone) {
  RecordedTime time;
  time.advance(100s);
  const RecordedTime::Step back = time.advance(40s);
  EXPECT_TRUE(back.backwards);
  EXPECT_EQ(back.length, 0s);
  EXPECT_FALSE(time.advance(41s).backwards);
  EXPECT_EQ(time.position(), 1s);
}

TEST(RecordedTime, StaysAtTheLargestValueInsteadOfOverflowing) {
  RecordedTime time;
  for (int round = 0; round < 3; ++round) {
    time.advance(nanoseconds::min());
    time.advance(nanoseconds::max());
  }
  EXPECT_EQ(time.position(), nanoseconds::max());
}

TEST(RecordedTimeSaturating, StopsAtTheBounds) {
  EXPECT_EQ(saturatingSum(nanoseconds::max(), 0ns), nanoseconds::max());
  EXPECT_EQ(saturatingSum(nanoseconds::max() - 1ns, 1ns), nanoseconds::max());
  EXPECT_EQ(saturatingSum(nanoseconds::max(), 1ns), nanoseconds::max());
  EXPECT_EQ(saturatingSum(nanoseconds::min(), -1ns), nanoseconds::min());
  EXPECT_EQ(saturatingSum(nanoseconds::min(), nanoseconds::max()), -1ns);
  EXPECT_EQ(saturatingDifference(nanoseconds::max(), -1ns), nanoseconds::max());
  EXPECT_EQ(saturatingDifference(nanoseconds::min(), 1ns), nanoseconds::min());
  EXPECT_EQ(saturatingDifference(nanoseconds::min() + 1ns, 1ns), nanoseconds::min());
  EXPECT_EQ(saturatingDifference(0ns, nanoseconds::min()), nanoseconds::max());
}

TEST(RecordedTimeLength, IsTheTimeBetweenTheFirstAndTheLastEvent) {
  ListStream stream({5000ms, 5500ms, 35'000ms, 25'000ms, 25'600ms});
  EXPECT_EQ(sources::lengthOf(stream, {}), 30'600ms);
  ListStream empty({});
  EXPECT_EQ(sources::lengthOf(empty, {}), 0ms);
}

TEST(RecordedTimeLength, IsUnknownWhenStoppedBeforeTheEnd) {
  std::stop_source stop;
  stop.request_stop();
  ListStream stream({0ms, 1ms});
  EXPECT_EQ(sources::lengthOf(stream, stop.get_token()), std::nullopt);
}

}  // namespace
}  // namespace vespscope::test
