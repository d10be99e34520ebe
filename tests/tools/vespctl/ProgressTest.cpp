// The progress line of a conversion.
#include <chrono>

#include <gtest/gtest.h>

#include "tools/vespctl/Progress.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using tools::progressText;

TEST(Progress, ShowsBytesRateAndTimeLeft) {
  EXPECT_EQ(progressText({12'300'000, 45'600'000}, 1234, 2s), "12.3 of 45.6 MB, 6.2 MB/s, 5 s left, 1234 events");
  EXPECT_EQ(progressText({1'000'000, 601'000'000}, 7, 1s), "1.0 of 601.0 MB, 1.0 MB/s, 10 min 0 s left, 7 events");
  EXPECT_EQ(progressText({1'000'000, 7'201'000'000}, 7, 1s), "1.0 of 7201.0 MB, 1.0 MB/s, 2 h 0 min left, 7 events");
}

TEST(Progress, LeavesOutWhatIsUnknown) {
  EXPECT_EQ(progressText({12'300'000, 0}, 1234, 2s), "12.3 MB, 6.2 MB/s, 1234 events");
  EXPECT_EQ(progressText({12'300'000, 12'300'000}, 1234, 2s), "12.3 of 12.3 MB, 6.2 MB/s, 1234 events");
  EXPECT_EQ(progressText({5, 10}, 1, 0ms), "0.0 of 0.0 MB, 1 events");
  EXPECT_EQ(progressText({}, 1234, 2s), "1234 events");
}

}  // namespace
}  // namespace vespscope::test
