// KCellularGsmScellInfo compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/gsm/KCellularGsmScellInfo.h"

namespace vespscope::test {
namespace {

TEST(KCellularGsmScellInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 20 80 80 04 28 7f 30 80 01 38 80 80 01 40 a9 01 48 b9 01 50 ff ff ff ff 0f 58 01 68 07";
  const auto read = readFrom<KCellularGsmScellInfo>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, mcc: 65536, mnc: 127, lac: 128, cell_id: 16384, gsm_band: (unknown: "
            "169), arfcn: 185, bsic: 4294967295, state: DEDICATED_STATE, num_mnc_digits: 7]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularGsmScellInfo written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(mcc, Mcc, 65536U);
  EXPECT_NUMBER(mnc, Mnc, 127U);
  EXPECT_NUMBER(lac, Lac, 128U);
  EXPECT_NUMBER(cellId, CellId, 16384U);
  EXPECT_NUMBER(gsmBand, GsmBand, 169);
  EXPECT_NUMBER(arfcn, Arfcn, 185U);
  EXPECT_NUMBER(bsic, Bsic, 4294967295U);
  EXPECT_NUMBER(state, State, 1);
  EXPECT_NUMBER(numMncDigits, NumMncDigits, 7U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
