// KCellularLteServingCellMeasurement compared with the bytes of another encoder: every field is read, shown, written
// and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/KCellularLteServingCellMeasurement.h"
#include "messages/lte/RxInfo.h"

namespace vespscope::test {
namespace {

TEST(KCellularLteServingCellMeasurement, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 81 d0 95 ff bc 31 10 01 1a 0d 08 7f 10 7f 18 80 01 20 ff ff ff ff 0f 1a 02 20 01";
  const auto read = readFrom<KCellularLteServingCellMeasurement>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, is_connected_mode: 1, rx_info: [[rssi: -64, rsrp_range: 127, rsrq_range: "
            "128, snr: -2147483648], [snr: -1]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteServingCellMeasurement written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_NUMBER(isConnectedMode, IsConnectedMode, true);
  EXPECT_MESSAGES(rxInfos, RxInfos, rxInfo, RxInfo,
                  readAll<RxInfo>({"08 7f 10 7f 18 80 01 20 ff ff ff ff 0f", "20 01"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
