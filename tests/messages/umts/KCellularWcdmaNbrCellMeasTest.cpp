// KCellularWcdmaNbrCellMeas compared with the bytes of another encoder: every field is read, shown, written and
// cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/umts/GsmCellMeasResult.h"
#include "messages/umts/KCellularWcdmaNbrCellMeas.h"
#include "messages/umts/LteCellMeasResult.h"
#include "messages/umts/UtraCellMeasResult.h"

namespace vespscope::test {
namespace {

TEST(KCellularWcdmaNbrCellMeas, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 12 13 08 80 01 10 80 80 01 18 b9 01 20 ff ff ff ff 0f 28 bd 01 12 02 28 18 1a 08 08 "
      "07 10 ac 02 18 96 0a 1a 04 18 ad a0 01 22 12 08 94 2d 10 00 18 80 80 04 20 ff 09 28 fe ff ff ff 0f 22 02 "
      "28 7e";
  const auto read = readFrom<KCellularWcdmaNbrCellMeas>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, meas_utra_result: [[uarfcn: 128, band: 16384, psc: 185, ecno: "
            "4294967295, rscp: -95], [rscp: 12]], meas_gsm_result: [[arfcn: 7, bsic: 300, rxlev: 1302], [rxlev: "
            "20525]], meas_lte_result: [[earfcn: 5780, phy_cell_id: 0, eutra_band: 65536, rsrp: -640, rsrq: "
            "2147483647], [rsrq: 63]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularWcdmaNbrCellMeas written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_MESSAGES(measUtraResults, MeasUtraResults, measUtraResult, MeasUtraResult,
                  readAll<UtraCellMeasResult>({"08 80 01 10 80 80 01 18 b9 01 20 ff ff ff ff 0f 28 bd 01", "28 18"}));
  EXPECT_MESSAGES(measGsmResults, MeasGsmResults, measGsmResult, MeasGsmResult,
                  readAll<GsmCellMeasResult>({"08 07 10 ac 02 18 96 0a", "18 ad a0 01"}));
  EXPECT_MESSAGES(measLteResults, MeasLteResults, measLteResult, MeasLteResult,
                  readAll<LteCellMeasResult>({"08 94 2d 10 00 18 80 80 04 20 ff 09 28 fe ff ff ff 0f", "28 7e"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
