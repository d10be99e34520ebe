// Area codes: numbers that mean no area.
#include <cstdint>

#include <gtest/gtest.h>

#include "radio/AreaCode.h"

namespace vespscope::test {
namespace {

using radio::AreaCode;

TEST(AreaCode, IsNothingForTheNumbersThatMeanNoArea) {
  EXPECT_EQ(AreaCode::fromNumber(1)->number(), 1);
  EXPECT_EQ(AreaCode::fromNumber(0xFFFD)->number(), 0xFFFD);
  for (const std::uint32_t none : {0U, 0xFFFEU, 0xFFFFU, 0x10000U, 0x10001U}) EXPECT_FALSE(AreaCode::fromNumber(none));
}

}  // namespace
}  // namespace vespscope::test
