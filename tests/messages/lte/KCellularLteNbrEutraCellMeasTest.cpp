// KCellularLteNbrEutraCellMeas compared with the bytes of another encoder: every field is read, shown, written and
// cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/EgwErrcNbrEutraMeas.h"
#include "messages/lte/KCellularLteNbrEutraCellMeas.h"

namespace vespscope::test {
namespace {

TEST(KCellularLteNbrEutraCellMeas, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 81 d0 95 ff bc 31 12 0e 08 7f 10 80 01 18 80 80 01 20 01 28 bd 01 12 02 28 18";
  const auto read = readFrom<KCellularLteNbrEutraCellMeas>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, meas_nbr_eutra: [[nbr_earfcn: 127, nbr_phys_cell_id: 128, freq_band_ind: "
            "16384, nbr_rsrp: -1, nbr_rsrq: -95], [nbr_rsrq: 12]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteNbrEutraCellMeas written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_MESSAGES(measNbrEutras, MeasNbrEutras, measNbrEutra, MeasNbrEutra,
                  readAll<EgwErrcNbrEutraMeas>({"08 7f 10 80 01 18 80 80 01 20 01 28 bd 01", "28 18"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
