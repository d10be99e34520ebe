// KCellularLteCarrierAggregationStatus compared with the bytes of another encoder: every field is read, shown, written
// and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/KCellularLteCarrierAggregationStatus.h"
#include "messages/lte/SecondaryComponentCarrier.h"

namespace vespscope::test {
namespace {

TEST(KCellularLteCarrierAggregationStatus, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 b5 88 86 fe ea 31 12 09 08 80 01 40 80 80 01 70 18 12 03 70 ff 09";
  const auto read = readFrom<KCellularLteCarrierAggregationStatus>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, scc_list: [[index: 128, ul_earfcn: 16384, rssi: 12], [rssi: -640]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteCarrierAggregationStatus written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_MESSAGES(sccLists, SccLists, sccList, SccList,
                  readAll<SecondaryComponentCarrier>({"08 80 01 40 80 80 01 70 18", "70 ff 09"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
