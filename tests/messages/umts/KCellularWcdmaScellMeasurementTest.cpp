// KCellularWcdmaScellMeasurement compared with the bytes of another encoder: every field is read, shown, written and
// cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/umts/KCellularWcdmaScellMeasurement.h"

namespace vespscope::test {
namespace {

TEST(KCellularWcdmaScellMeasurement, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 10 01 1a 0f 08 fe ff ff ff 0f 10 96 0a 18 ad a0 01 20 7e 1a 02 20 7f";
  const auto read = readFrom<KCellularWcdmaScellMeasurement>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, connected_mode: 1, rx_info: [[rssi: 2147483647, rsrp_range: 1302, "
            "rsrq_range: 20525, snr: 63], [snr: -64]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularWcdmaScellMeasurement written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(connectedMode, ConnectedMode, true);
  EXPECT_MESSAGES(rxInfos, RxInfos, rxInfo, RxInfo,
                  readAll<RxInfo>({"08 fe ff ff ff 0f 10 96 0a 18 ad a0 01 20 7e", "20 7f"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
