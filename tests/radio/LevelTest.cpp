// Reported levels: code to quantity and back, and what a receiver cannot have measured.
#include <gtest/gtest.h>

#include "radio/Bandwidth.h"
#include "radio/Levels.h"

namespace vespscope::test {
namespace {

using radio::Ecno;
using radio::Rscp;
using radio::Rsrp;
using radio::Rsrq;
using radio::Rxlev;

template <class Level>
class LevelScale : public testing::Test {};
using Scales = testing::Types<Rsrp, Rsrq, Rscp, Ecno, Rxlev>;
TYPED_TEST_SUITE(LevelScale, Scales);

TYPED_TEST(LevelScale, GivesBackEachCodeFromItsLevel) {
  int codes = 0;
  for (std::int32_t code = -200; code <= 200; ++code) {
    const auto level = TypeParam::fromCode(code);
    if (!level) continue;
    ++codes;
    EXPECT_EQ(level->code(), code);
    // The lowest codes of the extended ranges mean "below the measured range".
    if (!TypeParam::isMeasurable(level->level())) continue;
    ASSERT_TRUE(TypeParam::fromLevel(level->level())) << code;
    EXPECT_EQ(TypeParam::fromLevel(level->level())->code(), code);
  }
  EXPECT_GE(codes, 50);
}

TEST(Level, HasTheCodesOfTheReports) {
  EXPECT_EQ(Rsrp::fromLevel(-97)->code(), 43);
  EXPECT_EQ(Rsrp::fromLevel(-156)->code(), -16);
  EXPECT_EQ(Rsrq::fromLevel(-10)->code(), 19);
  EXPECT_EQ(Rsrq::fromLevel(2.5)->code(), 44);
  EXPECT_EQ(Rscp::fromLevel(-80)->code(), 36);
  EXPECT_EQ(Ecno::fromLevel(-6.5)->code(), 36);
  EXPECT_EQ(Rxlev::fromLevel(-63)->code(), 47);
  EXPECT_EQ(Rxlev::fromCode(47)->level(), -63);
}

TEST(Level, IsNothingBeyondWhatAReceiverMeasures) {
  EXPECT_FALSE(Rsrp::fromLevel(-180));
  EXPECT_FALSE(Rsrp::fromLevel(-43.9));
  EXPECT_FALSE(Rsrq::fromLevel(-34.5));
  EXPECT_FALSE(Rsrq::fromLevel(3));
  EXPECT_FALSE(Rscp::fromLevel(1));
  EXPECT_FALSE(Ecno::fromLevel(-51));
  EXPECT_FALSE(Rsrp::fromCode(98));
  EXPECT_FALSE(Rxlev::fromCode(64));
  EXPECT_FALSE(Rxlev::fromCode(-1));
}

TEST(Level, EndsAtTheOutermostCodeOfTheBasicRange) {
  EXPECT_EQ(Rsrp::basicCode(-150), 0U);
  EXPECT_EQ(Rsrp::basicCode(-20), 97U);
  EXPECT_EQ(Rsrq::basicCode(0), 34U);
  EXPECT_EQ(Rscp::fromLevel(-130)->code(), 0);
  EXPECT_EQ(Ecno::fromLevel(-30)->code(), 0);
}

}  // namespace
}  // namespace vespscope::test
