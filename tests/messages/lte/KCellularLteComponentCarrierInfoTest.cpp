// KCellularLteComponentCarrierInfo compared with the bytes of another encoder: every field is read, shown, written and
// cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/KCellularLteComponentCarrierInfo.h"

namespace vespscope::test {
namespace {

TEST(KCellularLteComponentCarrierInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 81 d0 95 ff bc 31 10 ac 02 18 96 0a 20 ad a0 01 28 94 2d 30 00 38 80 80 04";
  const auto read = readFrom<KCellularLteComponentCarrierInfo>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, pcc_earfcn: 300, scc0_earfcn: 1302, scc1_earfcn: 20525, pcc_bandwidth: "
            "5780, scc0_bandwidth: 0, scc1_bandwidth: 65536]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteComponentCarrierInfo written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_NUMBER(pccEarfcn, PccEarfcn, 300U);
  EXPECT_NUMBER(scc0Earfcn, Scc0Earfcn, 1302U);
  EXPECT_NUMBER(scc1Earfcn, Scc1Earfcn, 20525U);
  EXPECT_NUMBER(pccBandwidth, PccBandwidth, 5780U);
  EXPECT_NUMBER(scc0Bandwidth, Scc0Bandwidth, 0U);
  EXPECT_NUMBER(scc1Bandwidth, Scc1Bandwidth, 65536U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
