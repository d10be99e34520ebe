// KCellularLteNbrInterRatCellMeas compared with the bytes of another encoder: every field is read, shown, written and
// cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/EgwErrcNbrGeranMeas.h"
#include "messages/lte/EgwErrcNbrUtraMeas.h"
#include "messages/lte/KCellularLteNbrInterRatCellMeas.h"

namespace vespscope::test {
namespace {

TEST(KCellularLteNbrInterRatCellMeas, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 12 0c 08 96 0a 10 ad a0 01 18 7e 20 94 2d 12 02 20 00 1a 09 08 80 80 04 10 7f 18 80 "
      "01 1a 04 18 80 80 01";
  const auto read = readFrom<KCellularLteNbrInterRatCellMeas>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, meas_nbr_utra: [[uarfcn: 1302, psc: 20525, rscp: 63, ecno: 5780], [ecno: "
            "0]], meas_nbr_geran: [[arfcn: 65536, bsic: 127, rxlev: 128], [rxlev: 16384]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteNbrInterRatCellMeas written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_MESSAGES(measNbrUtras, MeasNbrUtras, measNbrUtra, MeasNbrUtra,
                  readAll<EgwErrcNbrUtraMeas>({"08 96 0a 10 ad a0 01 18 7e 20 94 2d", "20 00"}));
  EXPECT_MESSAGES(measNbrGerans, MeasNbrGerans, measNbrGeran, MeasNbrGeran,
                  readAll<EgwErrcNbrGeranMeas>({"08 80 80 04 10 7f 18 80 01", "18 80 80 01"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
