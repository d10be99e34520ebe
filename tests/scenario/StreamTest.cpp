#include <algorithm>
#include <string>

#include <gtest/gtest.h>

#include "manager/sources/scenario/ScenarioStream.h"
#include "registry/MetricRows.h"
#include "scenario/Drive.h"

namespace vespscope::manager::scenario {
namespace {

using namespace std::chrono_literals;

bool same(const MetricEvent& left, const MetricEvent& right) {
  return left.metricID == right.metricID && left.profileID == right.profileID && left.time == right.time &&
         left.payload == right.payload;
}

bool same(const std::vector<MetricEvent>& left, const std::vector<MetricEvent>& right) {
  return std::equal(left.begin(), left.end(), right.begin(), right.end(),
                    [](const MetricEvent& a, const MetricEvent& b) { return same(a, b); });
}

TEST(ScenarioStream, NamesItselfAndSaysThatItIsSimulated) {
  const auto stream = makeScenarioStream(7, driveStart);
  EXPECT_EQ(stream->label(), "scenario seed=7");
  EXPECT_EQ(stream->kind(), SourceKind::simulated);
  EXPECT_TRUE(stream->canRewind());
  EXPECT_EQ(stream->failure(), std::nullopt);
}

TEST(ScenarioStream, TheSameSeedGivesTheSameDrive) { EXPECT_TRUE(same(driveOf(3, 10min), driveOf(3, 10min))); }

TEST(ScenarioStream, DifferentSeedsGiveDifferentDrives) { EXPECT_FALSE(same(driveOf(3, 1min), driveOf(4, 1min))); }

TEST(ScenarioStream, RewindingBeginsTheSameDriveAgain) {
  const auto stream = makeScenarioStream(5, driveStart);
  std::vector<MetricEvent> first;
  std::vector<MetricEvent> second;
  for (int i = 0; i < 500; ++i) first.push_back(*stream->next());
  stream->rewind();
  for (int i = 0; i < 500; ++i) second.push_back(*stream->next());
  EXPECT_TRUE(same(first, second));
}

TEST(ScenarioStream, TheStartMovesTheTimesAndNothingElse) {
  const auto early = makeScenarioStream(2, driveStart);
  const auto late = makeScenarioStream(2, driveStart + 24h);
  for (int i = 0; i < 300; ++i) {
    const auto first = early->next();
    const auto second = late->next();
    ASSERT_EQ(first->metricID, second->metricID);
    ASSERT_EQ(first->time + 24h, second->time);
  }
}

// Every metric but the radio link failure, for which there is no message.
TEST(ScenarioStream, EveryKindOfMetricOccursWithinTwoMinutes) {
  for (std::uint64_t seed = 1; seed <= 40; ++seed) {
    const std::set<std::string_view> names = metricNames(driveOf(seed, 2min));
    for (const MetricRow& row : metricRows) {
      if (row.identifierName == "K_LTE_RLF") continue;
      EXPECT_TRUE(names.contains(row.identifierName)) << "seed " << seed << " lacks " << row.identifierName;
    }
    EXPECT_FALSE(names.contains("K_LTE_RLF"));
    EXPECT_FALSE(names.contains("")) << "an identifier without a row";
  }
}

TEST(ScenarioStream, TimeNeverRunsBackwards) {
  const std::vector<MetricEvent> events = driveOf(6, 30min);
  EXPECT_TRUE(std::is_sorted(events.begin(), events.end(),
                             [](const MetricEvent& a, const MetricEvent& b) { return a.time < b.time; }));
  EXPECT_GE(events.front().time, driveStart);
}

}  // namespace
}  // namespace vespscope::manager::scenario
