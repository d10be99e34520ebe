// SecondaryComponentCarrier compared with the bytes of another encoder: every field is read, shown, written and
// cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/SecondaryComponentCarrier.h"

namespace vespscope::test {
namespace {

TEST(SecondaryComponentCarrier, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b9 01 10 03 18 ff ff ff ff 0f 20 07 28 ac 02 30 96 0a 38 01 40 ad a0 01 48 94 2d 50 00 58 fe ff ff ff "
      "0f 60 7e 68 7f 70 ff ff ff ff 0f";
  const auto read = readFrom<SecondaryComponentCarrier>(encoded);
  EXPECT_EQ(textOf(*read),
            "[index: 185, state: (unknown: 3), pci: 4294967295, dl_earfcn: 7, dl_rf_band: 300, dl_bandwidth: "
            "1302, has_uplink: 1, ul_earfcn: 20525, ul_rf_band: 5780, ul_bandwidth: 0, rsrp: 2147483647, rsrq: "
            "63, snr: -64, rssi: -2147483648]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  SecondaryComponentCarrier written;
  EXPECT_NUMBER(index, Index, 185U);
  EXPECT_NUMBER(state, State, 3);
  EXPECT_NUMBER(pci, Pci, 4294967295U);
  EXPECT_NUMBER(dlEarfcn, DlEarfcn, 7U);
  EXPECT_NUMBER(dlRfBand, DlRfBand, 300U);
  EXPECT_NUMBER(dlBandwidth, DlBandwidth, 1302U);
  EXPECT_NUMBER(hasUplink, HasUplink, true);
  EXPECT_NUMBER(ulEarfcn, UlEarfcn, 20525U);
  EXPECT_NUMBER(ulRfBand, UlRfBand, 5780U);
  EXPECT_NUMBER(ulBandwidth, UlBandwidth, 0U);
  EXPECT_NUMBER(rsrp, Rsrp, 2147483647);
  EXPECT_NUMBER(rsrq, Rsrq, 63);
  EXPECT_NUMBER(snr, Snr, -64);
  EXPECT_NUMBER(rssi, Rssi, std::numeric_limits<std::int32_t>::min());
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
