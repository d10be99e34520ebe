// The age of a metric's latest report, and whether its technology still serves.
#include <gtest/gtest.h>

#include "shell/MetricAges.h"

namespace vespscope::test {
namespace {

using application::Freshness;
using application::freshnessOf;
using application::ScreenAge;
using namespace std::chrono_literals;

constexpr std::int64_t lteCell = metricIdentifier("K_LTE_SCELL_INFO");
constexpr std::int64_t lteLevels = metricIdentifier("K_LTE_RSRP_RSRQ_SINR");
constexpr std::int64_t lteState = metricIdentifier("K_LTE_RRC_STATE");
constexpr std::int64_t umtsCell = metricIdentifier("K_UMTS_SCELL_INFO");
constexpr std::int64_t umtsLevels = metricIdentifier("K_UMTS_SCELL_MEAS");
constexpr std::int64_t gsmLevels = metricIdentifier("K_GSM_IDLE_SCELL_MEAS");
constexpr std::int64_t gmmContext = metricIdentifier("K_CELLULAR_GMM_CTXT");
constexpr std::int64_t bearers = metricIdentifier("K_CELLULAR_ACTIVE_BEARER");

constexpr std::chrono::nanoseconds drive = 1'453'002'134s;  // in 2016

class MetricAgesTest : public ::testing::Test {
 protected:
  void report(std::int64_t identifier, std::chrono::nanoseconds own = drive) {
    ages.note(identifier, own, MetricAges::Clock::time_point(now));
  }
  [[nodiscard]] ScreenAge live(std::int64_t identifier) const {
    return ages.ageOf(identifier, {}, MetricAges::Clock::time_point(now));
  }
  [[nodiscard]] ScreenAge played(std::int64_t identifier, std::optional<std::chrono::nanoseconds> clock = {}) const {
    return ages.ageOf(identifier, {.connected = true, .recorded = true, .recordingClock = clock},
                      MetricAges::Clock::time_point(now));
  }

  MetricAges ages;
  std::chrono::nanoseconds now = 1000s;
};

TEST_F(MetricAgesTest, GivesNoAgeBeforeTheFirstReport) {
  report(lteCell);
  EXPECT_EQ(live(lteLevels).age, std::nullopt);
  EXPECT_EQ(live(12345).age, std::nullopt);
}

TEST_F(MetricAgesTest, CountsTheAgeOfALiveReportFromItsArrivalWhateverItsOwnTime) {
  report(lteLevels);
  now += 16s;
  report(lteState);
  EXPECT_EQ(live(lteLevels).age, 16s);
  EXPECT_EQ(live(lteState).age, 0s);
  EXPECT_EQ(freshnessOf(live(lteLevels)), Freshness::old);
  now += 1h;
  EXPECT_EQ(freshnessOf(live(lteState)), Freshness::current);  // a state holds until the next one
}

TEST_F(MetricAgesTest, CountsTheAgeInPlaybackOnTheRecordingsClock) {
  report(lteLevels, drive);
  report(lteState, drive + 7s);
  now += 1h;  // paused, or played slowly
  EXPECT_EQ(played(lteLevels).age, 7s);
  EXPECT_EQ(played(lteLevels, drive + 40s).age, 40s);
  EXPECT_EQ(played(lteState, drive + 40s).age, 33s);
  EXPECT_EQ(played(lteState, drive).age, 0s);  // a clock that was read slightly earlier
}

TEST_F(MetricAgesTest, CountsOnWhenARecordingStartsAgain) {
  report(lteLevels, drive + 100s);
  report(lteState, drive + 120s);
  report(lteState, drive);  // the next round
  report(lteState, drive + 10s);
  EXPECT_EQ(played(lteLevels, drive + 10s).age, 30s);
  EXPECT_EQ(played(lteState, drive + 15s).age, 5s);
}

TEST_F(MetricAgesTest, TakesAReportWithoutATimeAsNewAsTheNewestOne) {
  report(lteState, drive + 5s);
  ages.note(bearers, std::nullopt, MetricAges::Clock::time_point(now));
  EXPECT_EQ(played(bearers, drive + 9s).age, 4s);
}

TEST_F(MetricAgesTest, TakesAnotherTechnologyThatServesAsTheEndOfTheOneBefore) {
  report(lteCell);
  report(lteLevels);
  EXPECT_FALSE(live(lteLevels).lastKnown);
  report(umtsCell);
  report(umtsLevels);
  report(lteState);  // reported once more by the previous technology
  EXPECT_TRUE(live(lteLevels).lastKnown);
  EXPECT_TRUE(live(lteCell).lastKnown);
  EXPECT_FALSE(live(umtsLevels).lastKnown);
  report(lteLevels);
  EXPECT_FALSE(live(lteCell).lastKnown);
  EXPECT_TRUE(live(umtsCell).lastKnown);
}

TEST_F(MetricAgesTest, TakesTheContextsOfTheOlderTechnologiesAsLastKnownInLteOnly) {
  report(gmmContext);
  report(umtsCell);
  EXPECT_FALSE(live(gmmContext).lastKnown);
  report(gsmLevels);
  EXPECT_FALSE(live(gmmContext).lastKnown);
  report(lteCell);
  EXPECT_TRUE(live(gmmContext).lastKnown);
}

TEST_F(MetricAgesTest, TakesBearersAsValidWhateverServes) {
  report(bearers);
  for (const std::int64_t cell : {lteCell, umtsCell, gsmLevels}) {
    report(cell);
    EXPECT_FALSE(live(bearers).lastKnown);
  }
}

TEST_F(MetricAgesTest, TakesEverythingAsLastKnownWithoutAConnection) {
  report(lteCell);
  const MetricAges::Source lost{.connected = false, .recorded = false, .recordingClock = {}};
  EXPECT_TRUE(ages.ageOf(lteCell, lost, MetricAges::Clock::time_point(now)).lastKnown);
}

}  // namespace
}  // namespace vespscope::test
