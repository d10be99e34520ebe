// RsrpRsrqSinr compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/RsrpRsrqSinr.h"

namespace vespscope::test {
namespace {

TEST(RsrpRsrqSinr, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 ff ff ff ff 0f 20 fe ff ff ff 0f 28 7e 38 7f 40 ff ff ff ff 0f 50 01 58 bd 01";
  const auto read = readFrom<RsrpRsrqSinr>(encoded);
  EXPECT_EQ(textOf(*read),
            "[phy_cell_id: 4294967295, rsrp0: 2147483647, rsrp1: 63, rsrq0: -64, rsrq1: -2147483648, sinr0: -1, "
            "sinr1: -95]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  RsrpRsrqSinr written;
  EXPECT_NUMBER(phyCellId, PhyCellId, 4294967295U);
  EXPECT_NUMBER(rsrp0, Rsrp0, 2147483647);
  EXPECT_NUMBER(rsrp1, Rsrp1, 63);
  EXPECT_NUMBER(rsrq0, Rsrq0, -64);
  EXPECT_NUMBER(rsrq1, Rsrq1, std::numeric_limits<std::int32_t>::min());
  EXPECT_NUMBER(sinr0, Sinr0, -1);
  EXPECT_NUMBER(sinr1, Sinr1, -95);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
