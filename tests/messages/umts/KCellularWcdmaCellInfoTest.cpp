// KCellularWcdmaCellInfo compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/umts/KCellularWcdmaCellInfo.h"

namespace vespscope::test {
namespace {

TEST(KCellularWcdmaCellInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 20 80 01 28 80 80 01 30 b9 01 38 ff ff ff ff 0f 40 a8 01 48 07 50 ac 02 68 96 0a 70 01";
  const auto read = readFrom<KCellularWcdmaCellInfo>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, mcc: 128, mnc: 16384, lac: 185, cell_id: 4294967295, wcdma_band: "
            "SYS_BAND_UMTS_BAND6, dl_uarfcn: 7, psc: 300, num_mnc_digits: 1302, hspa: SYS_HS_IND_HSDPA_SUPP_CELL]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularWcdmaCellInfo written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(mcc, Mcc, 128U);
  EXPECT_NUMBER(mnc, Mnc, 16384U);
  EXPECT_NUMBER(lac, Lac, 185U);
  EXPECT_NUMBER(cellId, CellId, 4294967295U);
  EXPECT_NUMBER(wcdmaBand, WcdmaBand, 168);
  EXPECT_NUMBER(dlUarfcn, DlUarfcn, 7U);
  EXPECT_NUMBER(psc, Psc, 300U);
  EXPECT_NUMBER(numMncDigits, NumMncDigits, 1302U);
  EXPECT_NUMBER(hspa, Hspa, 1);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
