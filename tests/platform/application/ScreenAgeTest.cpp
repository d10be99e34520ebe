// The age of a screen's values in words.
#include <gtest/gtest.h>

#include "platform/application/ScreenAge.h"

namespace vespscope::test {
namespace {

using application::Freshness;
using application::freshnessOf;
using application::ScreenAge;
using application::screenAgeText;
using namespace std::chrono_literals;

TEST(ScreenAge, SaysNothingBeforeTheFirstReport) {
  EXPECT_EQ(freshnessOf({}), Freshness::none);
  EXPECT_EQ(screenAgeText({}), "");
}

TEST(ScreenAge, TakesAMeasurementOfMoreThanFifteenSecondsAsOld) {
  ScreenAge age{.age = 15s, .measurement = true};
  EXPECT_EQ(freshnessOf(age), Freshness::current);
  EXPECT_EQ(screenAgeText(age), "updated 15 s ago");
  age.age = 15001ms;
  EXPECT_EQ(freshnessOf(age), Freshness::old);
  EXPECT_EQ(screenAgeText(age), "updated 15 s ago");
}

TEST(ScreenAge, TakesAStateAsCurrentUntilTheNextOne) {
  const ScreenAge age{.age = 2h, .measurement = false};
  EXPECT_EQ(freshnessOf(age), Freshness::current);
  EXPECT_EQ(screenAgeText(age), "updated 2 h ago");
}

TEST(ScreenAge, SaysLastKnownOfWhatNothingReportsAnyMore) {
  const ScreenAge age{.age = 4min, .measurement = false, .lastKnown = true};
  EXPECT_EQ(freshnessOf(age), Freshness::lastKnown);
  EXPECT_EQ(screenAgeText(age), "last known, 4 min ago");
}

}  // namespace
}  // namespace vespscope::test
