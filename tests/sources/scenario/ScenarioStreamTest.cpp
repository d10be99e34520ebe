// A simulated drive is the same for the same seed.
#include <algorithm>
#include <string>

#include <gtest/gtest.h>

#include "registry/MetricRows.h"
#include "sources/scenario/Drive.h"
#include "sources/scenario/ScenarioStream.h"

namespace vespscope::test {
namespace {

using namespace sources;
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

TEST(ScenarioStream, TheSameSeedGivesTheSameDrive) { EXPECT_TRUE(same(driveOf(3, 5min), driveOf(3, 5min))); }

// FNV-1a over identifiers, times since the start and payloads. The number changes whenever the drive does: then check a
// tour of the new drive before changing the number.
TEST(ScenarioStream, TheDriveIsTheOneItAlwaysWas) {
  std::uint64_t digest = 0xCBF29CE484222325U;
  const auto add = [&digest](std::uint64_t value, int bytes) {
    for (int i = 0; i < bytes; ++i) {
      digest = (digest ^ (value >> (8 * i) & 0xFFU)) * 0x100000001B3U;
    }
  };
  const auto stream = makeScenarioStream(1, driveStart);
  for (int i = 0; i < 8000; ++i) {
    const MetricEvent event = *stream->next();
    add(static_cast<std::uint64_t>(event.metricID), 4);
    add(static_cast<std::uint64_t>((event.time - driveStart).count()), 8);
    for (const std::uint8_t byte : event.payload) add(byte, 1);
  }
  EXPECT_EQ(digest, 0xE34F66EBA2CD6CF2U) << std::hex << digest;
}

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

// Every metric except the radio link failure, which has no message.
TEST(ScenarioStream, EveryKindOfMetricOccursWithinTwoMinutes) {
  for (std::uint64_t seed = 1; seed <= 20; ++seed) {
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
  const std::vector<MetricEvent> events = driveOf(6, 10min);
  EXPECT_TRUE(std::is_sorted(events.begin(), events.end(),
                             [](const MetricEvent& a, const MetricEvent& b) { return a.time < b.time; }));
  EXPECT_GE(events.front().time, driveStart);
}

}  // namespace
}  // namespace vespscope::test
