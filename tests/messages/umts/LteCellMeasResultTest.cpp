// LteCellMeasResult compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/umts/LteCellMeasResult.h"

namespace vespscope::test {
namespace {

TEST(LteCellMeasResult, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 96 0a 10 ad a0 01 18 94 2d 20 ff ff ff ff 0f 28 01";
  const auto read = readFrom<LteCellMeasResult>(encoded);
  EXPECT_EQ(textOf(*read), "[earfcn: 1302, phy_cell_id: 20525, eutra_band: 5780, rsrp: -2147483648, rsrq: -1]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  LteCellMeasResult written;
  EXPECT_NUMBER(earfcn, Earfcn, 1302U);
  EXPECT_NUMBER(phyCellId, PhyCellId, 20525U);
  EXPECT_NUMBER(eutraBand, EutraBand, 5780U);
  EXPECT_NUMBER(rsrp, Rsrp, std::numeric_limits<std::int32_t>::min());
  EXPECT_NUMBER(rsrq, Rsrq, -1);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
