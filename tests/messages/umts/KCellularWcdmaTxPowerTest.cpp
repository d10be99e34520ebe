// KCellularWcdmaTxPower compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/umts/KCellularWcdmaTxPower.h"

namespace vespscope::test {
namespace {

TEST(KCellularWcdmaTxPower, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 81 d0 95 ff bc 31 12 0a 08 ff ff ff ff 0f 10 01 18 00 12 04 18 80 80 04";
  const auto read = readFrom<KCellularWcdmaTxPower>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, tx_power_info: [[pucch_tx_power: -2147483648, pusch_tx_power: -1, "
            "subframe_index: 0], [subframe_index: 65536]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularWcdmaTxPower written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_MESSAGES(txPowerInfos, TxPowerInfos, txPowerInfo, TxPowerInfo,
                  readAll<TxPowerInfo>({"08 ff ff ff ff 0f 10 01 18 00", "18 80 80 04"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
