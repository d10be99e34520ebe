// EgwErrcNbrEutraMeas compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/EgwErrcNbrEutraMeas.h"

namespace vespscope::test {
namespace {

TEST(EgwErrcNbrEutraMeas, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 b9 01 10 ff ff ff ff 0f 18 07 20 ff 09 28 fe ff ff ff 0f";
  const auto read = readFrom<EgwErrcNbrEutraMeas>(encoded);
  EXPECT_EQ(textOf(*read),
            "[nbr_earfcn: 185, nbr_phys_cell_id: 4294967295, freq_band_ind: 7, nbr_rsrp: -640, nbr_rsrq: "
            "2147483647]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  EgwErrcNbrEutraMeas written;
  EXPECT_NUMBER(nbrEarfcn, NbrEarfcn, 185U);
  EXPECT_NUMBER(nbrPhysCellId, NbrPhysCellId, 4294967295U);
  EXPECT_NUMBER(freqBandInd, FreqBandInd, 7U);
  EXPECT_NUMBER(nbrRsrp, NbrRsrp, -640);
  EXPECT_NUMBER(nbrRsrq, NbrRsrq, 2147483647);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
