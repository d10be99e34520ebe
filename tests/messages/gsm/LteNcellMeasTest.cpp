// LteNcellMeas compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/gsm/LteNcellMeas.h"

namespace vespscope::test {
namespace {

TEST(LteNcellMeas, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 ff ff ff ff 0f 10 07 18 ac 02 20 96 0a 28 ad a0 01";
  const auto read = readFrom<LteNcellMeas>(encoded);
  EXPECT_EQ(textOf(*read), "[physical_cell_id: 4294967295, bandwidth: 7, rsrp: 300, earfcn: 1302, rsrq: 20525]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  LteNcellMeas written;
  EXPECT_NUMBER(physicalCellId, PhysicalCellId, 4294967295U);
  EXPECT_NUMBER(bandwidth, Bandwidth, 7U);
  EXPECT_NUMBER(rsrp, Rsrp, 300U);
  EXPECT_NUMBER(earfcn, Earfcn, 1302U);
  EXPECT_NUMBER(rsrq, Rsrq, 20525U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
