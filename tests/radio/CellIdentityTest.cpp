// Area codes and cell identities: ranges, reserved numbers, and the node and the cell within an identity.
#include <gtest/gtest.h>

#include "radio/AreaCode.h"
#include "radio/CellIdentity.h"

namespace vespscope::test {
namespace {

using radio::EutraCellIdentity;
using radio::UtraCellIdentity;

TEST(CellIdentity, NamesTheBaseStationAndTheSector) {
  const auto cell = EutraCellIdentity::fromNumber(0x1C3D6E5);
  ASSERT_TRUE(cell);
  EXPECT_EQ(cell->node(), 0x1C3D6U);
  EXPECT_EQ(cell->cell(), 0xE5U);
  EXPECT_EQ(EutraCellIdentity::fromParts(0x1C3D6, 0xE5), cell);
}

TEST(CellIdentity, NamesTheControllerAndItsCell) {
  const auto cell = UtraCellIdentity::fromNumber(0xABCDEF1);
  ASSERT_TRUE(cell);
  EXPECT_EQ(cell->node(), 0xABCU);
  EXPECT_EQ(cell->cell(), 0xDEF1U);
}

TEST(CellIdentity, HasTwentyEightBits) {
  EXPECT_TRUE(EutraCellIdentity::fromNumber(0x0FFFFFFF));
  EXPECT_FALSE(EutraCellIdentity::fromNumber(0x10000000));
  EXPECT_FALSE(EutraCellIdentity::fromParts(0x100000, 0));
  EXPECT_FALSE(EutraCellIdentity::fromParts(0, 0x100));
  EXPECT_FALSE(UtraCellIdentity::fromParts(0x1000, 0));
}

}  // namespace
}  // namespace vespscope::test
