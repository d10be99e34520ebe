// KCellularLteRsrpRsrqSinr compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/KCellularLteRsrpRsrqSinr.h"
#include "messages/lte/RsrpRsrqSinr.h"

namespace vespscope::test {
namespace {

TEST(KCellularLteRsrpRsrqSinr, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 1a 0c 76 6f 6c 74 65 2d 63 61 6c 6c 2d 37 30 94 2d 38 00 40 80 80 04 50 7f 58 80 01 "
      "72 0c 08 80 80 01 38 ff ff ff ff 0f 58 01 7a 08 08 b9 01 38 bd 01 58 18 7a 03 58 ff 09";
  const auto read = readFrom<KCellularLteRsrpRsrqSinr>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, call_id: volte-call-7, last_x_seconds: 5780, last_y_samples: 0, "
            "sample_period_ms: 65536, duration_ms: 127, num_samples: 128, avg_values: [phy_cell_id: 16384, "
            "rsrq0: -2147483648, sinr1: -1], inst_values: [[phy_cell_id: 185, rsrq0: -95, sinr1: 12], [sinr1: "
            "-640]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteRsrpRsrqSinr written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_CONTENT(callId, CallId, std::string("volte-call-7"));
  EXPECT_NUMBER(lastXSeconds, LastXSeconds, 5780U);
  EXPECT_NUMBER(lastYSamples, LastYSamples, 0U);
  EXPECT_NUMBER(samplePeriodMs, SamplePeriodMs, 65536U);
  EXPECT_NUMBER(durationMs, DurationMs, 127U);
  EXPECT_NUMBER(numSamples, NumSamples, 128U);
  EXPECT_MESSAGE(avgValues, AvgValues, readFrom<RsrpRsrqSinr>("08 80 80 01 38 ff ff ff ff 0f 58 01"));
  EXPECT_MESSAGES(instValues, InstValues, instValues, InstValues,
                  readAll<RsrpRsrqSinr>({"08 b9 01 38 bd 01 58 18", "58 ff 09"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
