// EgwErrcNbrGeranMeas compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/EgwErrcNbrGeranMeas.h"

namespace vespscope::test {
namespace {

TEST(EgwErrcNbrGeranMeas, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 ac 02 10 96 0a 18 ad a0 01";
  const auto read = readFrom<EgwErrcNbrGeranMeas>(encoded);
  EXPECT_EQ(textOf(*read), "[arfcn: 300, bsic: 1302, rxlev: 20525]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  EgwErrcNbrGeranMeas written;
  EXPECT_NUMBER(arfcn, Arfcn, 300U);
  EXPECT_NUMBER(bsic, Bsic, 1302U);
  EXPECT_NUMBER(rxlev, Rxlev, 20525U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
