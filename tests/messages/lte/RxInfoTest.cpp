// RxInfo compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/RxInfo.h"

namespace vespscope::test {
namespace {

TEST(RxInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 bd 01 10 80 80 01 18 b9 01 20 18";
  const auto read = readFrom<RxInfo>(encoded);
  EXPECT_EQ(textOf(*read), "[rssi: -95, rsrp_range: 16384, rsrq_range: 185, snr: 12]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  RxInfo written;
  EXPECT_NUMBER(rssi, Rssi, -95);
  EXPECT_NUMBER(rsrpRange, RsrpRange, 16384U);
  EXPECT_NUMBER(rsrqRange, RsrqRange, 185U);
  EXPECT_NUMBER(snr, Snr, 12);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
