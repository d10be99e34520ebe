// TxPowerInfo compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/TxPowerInfo.h"

namespace vespscope::test {
namespace {

TEST(TxPowerInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 7e 10 7f 18 96 0a";
  const auto read = readFrom<TxPowerInfo>(encoded);
  EXPECT_EQ(textOf(*read), "[pucch_tx_power: 63, pusch_tx_power: -64, subframe_index: 1302]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  TxPowerInfo written;
  EXPECT_NUMBER(pucchTxPower, PucchTxPower, 63);
  EXPECT_NUMBER(puschTxPower, PuschTxPower, -64);
  EXPECT_NUMBER(subframeIndex, SubframeIndex, 1302U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
