// UmtsNcellMeas compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/gsm/UmtsNcellMeas.h"

namespace vespscope::test {
namespace {

TEST(UmtsNcellMeas, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 80 80 04 10 7f 18 80 01 20 80 80 01 28 b9 01";
  const auto read = readFrom<UmtsNcellMeas>(encoded);
  EXPECT_EQ(textOf(*read), "[cell_type: 65536, cpich_sc: 127, dl_uarfcn: 128, cpich_rscp: 16384, cpich_ecn0: 185]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  UmtsNcellMeas written;
  EXPECT_NUMBER(cellType, CellType, 65536U);
  EXPECT_NUMBER(cpichSc, CpichSc, 127U);
  EXPECT_NUMBER(dlUarfcn, DlUarfcn, 128U);
  EXPECT_NUMBER(cpichRscp, CpichRscp, 16384U);
  EXPECT_NUMBER(cpichEcn0, CpichEcn0, 185U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
