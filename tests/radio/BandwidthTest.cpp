// The bandwidths of LTE: code to resource blocks and MHz.
#include <gtest/gtest.h>

#include "radio/Bandwidth.h"
#include "radio/Levels.h"

namespace vespscope::test {
namespace {

using radio::Bandwidth;

TEST(Bandwidth, KnowsTheSixWidths) {
  const std::uint32_t blocks[] = {6, 15, 25, 50, 75, 100};
  const std::uint32_t steps[] = {3, 6, 10, 20, 30, 40};
  for (std::uint32_t code = 0; code < 6; ++code) {
    const auto width = Bandwidth::fromCode(code);
    ASSERT_TRUE(width);
    EXPECT_EQ(width->resourceBlocks(), blocks[code]);
    EXPECT_EQ(width->halfMegahertz(), steps[code]);
    EXPECT_EQ(Bandwidth::fromResourceBlocks(blocks[code]), width);
  }
  EXPECT_FALSE(Bandwidth::fromCode(6));
  EXPECT_FALSE(Bandwidth::fromResourceBlocks(24));
}

}  // namespace
}  // namespace vespscope::test
