// Sizes and durations as options name them.
#include <gtest/gtest.h>

#include "tools/Quantities.h"

namespace vespscope::test {
namespace {

TEST(Quantities, AreWholeNumbersOfOneUnit) {
  using namespace std::chrono_literals;
  EXPECT_EQ(parseSize("1"), 1U);
  EXPECT_EQ(parseSize("24K"), 24U * 1024);
  EXPECT_EQ(parseSize("64M"), 64U << 20);
  EXPECT_EQ(parseSize("3G"), std::uint64_t{3} << 30);
  EXPECT_EQ(parseSize("1048576G"), std::uint64_t{1} << 50);
  for (const auto* words : {"", "K", "0", "0M", "-1", "+1", "1k", "1MB", "1.5M", " 1", "1 M", "1048577G",
                            "99999999999999999999", "1099511627777K"}) {
    EXPECT_EQ(parseSize(words), std::nullopt) << words;
  }
  EXPECT_EQ(parseDuration("90s"), 90s);
  EXPECT_EQ(parseDuration("15m"), 15min);
  EXPECT_EQ(parseDuration("1h"), 1h);
  EXPECT_EQ(parseDuration("7d"), 168h);
  for (const auto* words : {"", "1", "s", "0s", "1M", "1w", "36501d", "1h30m"}) {
    EXPECT_EQ(parseDuration(words), std::nullopt) << words;
  }
}

}  // namespace
}  // namespace vespscope::test
