// Times, ages and positions as short text.
#include <cstdlib>

#include <gtest/gtest.h>

#include "platform/application/ClockText.h"

namespace vespscope::test {
namespace {

using application::ageText;
using application::agoText;
using application::positionText;
using namespace std::chrono_literals;
using TimePoint = std::chrono::system_clock::time_point;

TEST(ClockText, GivesAgesTheUnitThatSuitsThem) {
  EXPECT_EQ(ageText(0s), "0 s");
  EXPECT_EQ(ageText(59s), "59 s");
  EXPECT_EQ(ageText(60s), "1 min");
  EXPECT_EQ(ageText(3599s), "59 min");
  EXPECT_EQ(ageText(3600s), "1 h");
  EXPECT_EQ(ageText(86400s), "1 d");
}

TEST(ClockText, CountsAnAgeBelowZeroAsZero) { EXPECT_EQ(ageText(-5s), "0 s"); }

TEST(ClockText, SaysHowLongAgo) {
  EXPECT_EQ(agoText(999ms), "now");
  EXPECT_EQ(agoText(-5s), "now");
  EXPECT_EQ(agoText(3s), "3 s ago");
  EXPECT_EQ(agoText(4min), "4 min ago");
}

TEST(ClockText, WritesPositionsWithHoursOnlyWhenThereAreSome) {
  EXPECT_EQ(positionText(-1s), "00:00");
  EXPECT_EQ(positionText(97s), "01:37");
  EXPECT_EQ(positionText(3599999ms), "59:59");
  EXPECT_EQ(positionText(3697s), "1:01:37");
}

TEST(ClockText, WritesTimesBefore1970AsWholeSecondsToo) {
  ::setenv("TZ", "UTC", 1);
  EXPECT_EQ(application::timeOfDay(TimePoint(-500ms)), "23:59:59");
  EXPECT_EQ(application::dateAndTime(TimePoint(-500ms)), "1969-12-31 23:59:59");
  EXPECT_EQ(application::dateAndTime(TimePoint(1'700'000'000s)), "2023-11-14 22:13:20");
}

}  // namespace
}  // namespace vespscope::test
