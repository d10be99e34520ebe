// KCellularGsmGrrEventMeasCr compared with the bytes of another encoder: every field is read, shown, written and
// cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/gsm/GsmNcellMeas.h"
#include "messages/gsm/KCellularGsmGrrEventMeasCr.h"
#include "messages/gsm/LteNcellMeas.h"
#include "messages/gsm/UmtsNcellMeas.h"

namespace vespscope::test {
namespace {

TEST(KCellularGsmGrrEventMeasCr, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 81 d0 95 ff bc 31 12 09 08 7f 20 80 01 38 80 80 01 12 03 38 b9 01 1a 12 08 ff ff ff ff 0f 10 07 18 ac "
      "02 20 96 0a 28 ad a0 01 1a 03 28 94 2d 22 0f 08 00 10 80 80 04 18 7f 20 80 01 28 80 80 01 22 03 28 b9 01";
  const auto read = readFrom<KCellularGsmGrrEventMeasCr>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, gsm_ncell_meas: [[mcc: 127, ci: 128, rxlev: 16384], [rxlev: 185]], "
            "umts_ncell_meas: [[cell_type: 4294967295, cpich_sc: 7, dl_uarfcn: 300, cpich_rscp: 1302, "
            "cpich_ecn0: 20525], [cpich_ecn0: 5780]], lte_ncell_meas: [[physical_cell_id: 0, bandwidth: 65536, "
            "rsrp: 127, earfcn: 128, rsrq: 16384], [rsrq: 185]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularGsmGrrEventMeasCr written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_MESSAGES(gsmNcellMeas, GsmNcellMeas, gsmNcellMeas, GsmNcellMeas,
                  readAll<GsmNcellMeas>({"08 7f 20 80 01 38 80 80 01", "38 b9 01"}));
  EXPECT_MESSAGES(umtsNcellMeas, UmtsNcellMeas, umtsNcellMeas, UmtsNcellMeas,
                  readAll<UmtsNcellMeas>({"08 ff ff ff ff 0f 10 07 18 ac 02 20 96 0a 28 ad a0 01", "28 94 2d"}));
  EXPECT_MESSAGES(lteNcellMeas, LteNcellMeas, lteNcellMeas, LteNcellMeas,
                  readAll<LteNcellMeas>({"08 00 10 80 80 04 18 7f 20 80 01 28 80 80 01", "28 b9 01"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
