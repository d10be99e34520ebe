// Timer values of literal octets (3GPP TS 24.008 10.5.7.3).
#include <gtest/gtest.h>

#include "sources/nas/Timers.h"

namespace vespscope::test {
namespace {

using namespace sources::nas;

TEST(Timers, HaveTheirUnitInTheHighestBits) {
  EXPECT_EQ(timerSeconds(0x05), 10U);
  EXPECT_EQ(timerSeconds(0x25), 300U);
  EXPECT_EQ(timerSeconds(0x49), 3240U);
  EXPECT_EQ(timerSeconds(0x65), 300U);
  EXPECT_FALSE(timerSeconds(0xE5));
  EXPECT_EQ(timer3Seconds(0x01), 600U);
  EXPECT_EQ(timer3Seconds(0x22), 7200U);
  EXPECT_EQ(timer3Seconds(0x41), 36'000U);
  EXPECT_EQ(timer3Seconds(0x63), 6U);
  EXPECT_EQ(timer3Seconds(0x82), 60U);
  EXPECT_EQ(timer3Seconds(0xA2), 120U);
  EXPECT_EQ(timer3Seconds(0xC1), 1'152'000U);
  EXPECT_FALSE(timer3Seconds(0xE1));
}

}  // namespace
}  // namespace vespscope::test
