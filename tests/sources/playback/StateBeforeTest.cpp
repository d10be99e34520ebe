// The state of a recording before the moment where playing starts.
#include <cstdint>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "sources/playback/StateBefore.h"

namespace vespscope::test {
namespace {

using sources::StateBefore;
using testing::ElementsAre;
using testing::IsEmpty;

MetricEvent event(std::int32_t metric, std::int32_t profile, std::uint8_t number) {
  return {metric, profile, {number}, {}};
}

std::vector<int> numbersOf(StateBefore& state) {
  std::vector<int> numbers;
  for (const MetricEvent& one : state.release()) numbers.push_back(one.payload.at(0));
  return numbers;
}

TEST(StateBefore, IsTheLatestEventOfEachMetricAndProfileInTheirOrder) {
  StateBefore state;
  state.take(event(1, 0, 10));
  state.take(event(2, 0, 11));
  state.take(event(1, 1, 12));
  state.take(event(1, 0, 13));
  EXPECT_THAT(numbersOf(state), ElementsAre(11, 12, 13));
  EXPECT_THAT(state.release(), IsEmpty());
}

TEST(StateBefore, KeepsAsManyMetricsAsItsLimit) {
  StateBefore state;
  constexpr auto limit = static_cast<std::int32_t>(StateBefore::metricLimit);
  for (std::int32_t metric = 0; metric < limit; ++metric) state.take(event(metric, 0, 1));
  EXPECT_EQ(state.leftOut(), 0U);
  state.take(event(limit, 0, 2));
  EXPECT_EQ(state.leftOut(), 1U);
  state.take(event(limit - 1, 0, 3));  // replaces a stored one
  EXPECT_EQ(state.leftOut(), 1U);
  const std::vector<MetricEvent> kept = state.release();
  EXPECT_EQ(kept.size(), StateBefore::metricLimit);
  EXPECT_EQ(kept.back().payload, Bytes{3});
  EXPECT_EQ(state.leftOut(), 0U);
}

TEST(StateBefore, KeepsAsManyBytesAsItsLimit) {
  StateBefore state;
  state.take({1, 0, Bytes(StateBefore::byteLimit), {}});
  EXPECT_EQ(state.leftOut(), 0U);
  state.take({2, 0, Bytes(1), {}});
  EXPECT_EQ(state.leftOut(), 1U);
  state.take({1, 0, Bytes(StateBefore::byteLimit - 1), {}});
  state.take({2, 0, Bytes(1), {}});
  EXPECT_EQ(state.leftOut(), 1U);
  EXPECT_EQ(state.release().size(), 2U);
}

}  // namespace
}  // namespace vespscope::test
