// How many lines of one kind reach the system log, and how the others are reported.
#include <string>

#include "CoreTesting.h"
#include "manager/LogRate.h"

namespace vespscope::test {
namespace {

using manager::LogRate;

TEST(LogRate, WritesEightLinesInTenSecondsAndCountsTheOthers) {
  log::discardOutputs();
  const LoggedLines lines;
  LogRate rate("refused clients");
  const LogRate::Clock::time_point begin = LogRate::Clock::now();
  for (int count = 0; count < 8; ++count) rate.write("line", begin + std::chrono::milliseconds(count));
  EXPECT_EQ(rate.report(begin + 1s), std::nullopt);
  EXPECT_EQ(lines.all().size(), 8U);
  for (int count = 0; count < 100'000; ++count) rate.write("line", begin + 2s);
  EXPECT_EQ(lines.all().size(), 8U);
  EXPECT_EQ(rate.report(begin + 9999ms), begin + 10s);
  EXPECT_EQ(lines.all().size(), 8U);
  EXPECT_EQ(rate.report(begin + 10s), std::nullopt);
  ASSERT_EQ(lines.all().size(), 9U);
  EXPECT_EQ(lines.all().back(), "100000 more refused clients are not in the log");
}

TEST(LogRate, WritesAgainInTheNextPeriod) {
  log::discardOutputs();
  const LoggedLines lines;
  LogRate rate("refused clients");
  const LogRate::Clock::time_point begin = LogRate::Clock::now();
  for (int count = 0; count < 9; ++count) rate.write("line", begin);
  rate.write("later", begin + 10s);
  ASSERT_EQ(lines.all().size(), 10U);
  EXPECT_EQ(lines.all()[8], "1 more refused clients are not in the log");
  EXPECT_EQ(lines.all()[9], "later");
  EXPECT_EQ(rate.report(begin + 30s), std::nullopt);
  EXPECT_EQ(lines.all().size(), 10U);
}

}  // namespace
}  // namespace vespscope::test
