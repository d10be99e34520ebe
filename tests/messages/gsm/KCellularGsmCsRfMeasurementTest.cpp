// KCellularGsmCsRfMeasurement compared with the bytes of another encoder: every field is read, shown, written and
// cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/gsm/KCellularGsmCsRfMeasurement.h"

namespace vespscope::test {
namespace {

TEST(KCellularGsmCsRfMeasurement, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 b5 88 86 fe ea 31 10 07 18 ac 02 20 96 0a 2a 03 01 02 42 30 ad a0 01 38 94 2d 40 00";
  const auto read = readFrom<KCellularGsmCsRfMeasurement>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, scell_arfcn: 7, simplified_l1_state: 300, current_antenna: 1302, "
            "cs_tx_pwr: [-1, 1, 33], cs_rxlev_sub: 20525, cs_rxqual_sub: 5780, scell_band: 0]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularGsmCsRfMeasurement written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(scellArfcn, ScellArfcn, 7U);
  EXPECT_NUMBER(simplifiedL1State, SimplifiedL1State, 300U);
  EXPECT_NUMBER(currentAntenna, CurrentAntenna, 1302U);
  EXPECT_NUMBERS(csTxPwrs, CsTxPwrs, csTxPwr, CsTxPwr, <std::int32_t>{-1, 1, 33});
  EXPECT_NUMBER(csRxlevSub, CsRxlevSub, 20525U);
  EXPECT_NUMBER(csRxqualSub, CsRxqualSub, 5780U);
  EXPECT_NUMBER(scellBand, ScellBand, 0U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
