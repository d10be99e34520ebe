// GsmNcellMeas compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/gsm/GsmNcellMeas.h"

namespace vespscope::test {
namespace {

TEST(GsmNcellMeas, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 ff ff ff ff 0f 10 07 18 ac 02 20 96 0a 28 ad a0 01 30 94 2d 38 00";
  const auto read = readFrom<GsmNcellMeas>(encoded);
  EXPECT_EQ(textOf(*read), "[mcc: 4294967295, mnc: 7, lac: 300, ci: 1302, bsic: 20525, arfcn: 5780, rxlev: 0]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  GsmNcellMeas written;
  EXPECT_NUMBER(mcc, Mcc, 4294967295U);
  EXPECT_NUMBER(mnc, Mnc, 7U);
  EXPECT_NUMBER(lac, Lac, 300U);
  EXPECT_NUMBER(ci, Ci, 1302U);
  EXPECT_NUMBER(bsic, Bsic, 20525U);
  EXPECT_NUMBER(arfcn, Arfcn, 5780U);
  EXPECT_NUMBER(rxlev, Rxlev, 0U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
