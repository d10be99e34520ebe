// KCellularLteTxPower compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/KCellularLteTxPower.h"
#include "messages/lte/TxPowerInfo.h"

namespace vespscope::test {
namespace {

TEST(KCellularLteTxPower, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 b5 88 86 fe ea 31 12 0b 08 ff 09 10 fe ff ff ff 0f 18 07 12 03 18 ac 02";
  const auto read = readFrom<KCellularLteTxPower>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, tx_power_info: [[pucch_tx_power: -640, pusch_tx_power: 2147483647, "
            "subframe_index: 7], [subframe_index: 300]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteTxPower written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_MESSAGES(txPowerInfos, TxPowerInfos, txPowerInfo, TxPowerInfo,
                  readAll<TxPowerInfo>({"08 ff 09 10 fe ff ff ff 0f 18 07", "18 ac 02"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
