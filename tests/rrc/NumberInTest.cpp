// Numbers in the names of enumerated values.
#include <gtest/gtest.h>

#include "rrc/Message.h"

namespace vespscope::test {
namespace {

using namespace rrc;

TEST(NumberIn, ReadsTheNumberOfAName) {
  EXPECT_EQ(numberIn("psf10"), 10);
  EXPECT_EQ(numberIn("dB-24"), -24);
  EXPECT_EQ(numberIn("psf0-v1020"), 0);
  EXPECT_EQ(numberIn("ms10000-v1310"), 10000);
  EXPECT_FALSE(numberIn("spare3"));
  EXPECT_FALSE(numberIn("infinity"));
  EXPECT_FALSE(numberIn(""));
}

}  // namespace
}  // namespace vespscope::test
