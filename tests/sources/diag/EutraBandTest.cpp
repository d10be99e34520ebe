#include <gtest/gtest.h>

#include "sources/diag/EutraBand.h"

namespace vespscope::sources::diag {
namespace {

TEST(EutraBand, ACarrierLiesInTheBandOfItsRange) {
  EXPECT_EQ(eutraBandOfDownlink(0), 1U);
  EXPECT_EQ(eutraBandOfDownlink(599), 1U);
  EXPECT_EQ(eutraBandOfDownlink(700), 2U);
  EXPECT_EQ(eutraBandOfDownlink(1300), 3U);
  EXPECT_EQ(eutraBandOfDownlink(2000), 4U);
  EXPECT_EQ(eutraBandOfDownlink(2425), 5U);
  EXPECT_EQ(eutraBandOfDownlink(5780), 17U);
  EXPECT_EQ(eutraBandOfDownlink(6300), 20U);
  EXPECT_EQ(eutraBandOfDownlink(9820), 30U);
  EXPECT_EQ(eutraBandOfDownlink(38750), 40U);
  EXPECT_EQ(eutraBandOfDownlink(66536), 66U);
  EXPECT_EQ(eutraBandOfDownlink(70645), 88U);
}

TEST(EutraBand, ANumberBetweenTheRangesHasNoBand) {
  EXPECT_EQ(eutraBandOfDownlink(4950), std::nullopt);
  EXPECT_EQ(eutraBandOfDownlink(5400), std::nullopt);
  EXPECT_EQ(eutraBandOfDownlink(7400), std::nullopt);
  EXPECT_EQ(eutraBandOfDownlink(10360), std::nullopt);
  EXPECT_EQ(eutraBandOfDownlink(23780), std::nullopt);
  EXPECT_EQ(eutraBandOfDownlink(65535), std::nullopt);
  EXPECT_EQ(eutraBandOfDownlink(0xFFFFFFFF), std::nullopt);
}

}  // namespace
}  // namespace vespscope::sources::diag
