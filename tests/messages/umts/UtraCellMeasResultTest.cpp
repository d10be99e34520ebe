// UtraCellMeasResult compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/umts/UtraCellMeasResult.h"

namespace vespscope::test {
namespace {

TEST(UtraCellMeasResult, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 7f 10 80 01 18 80 80 01 20 b9 01 28 7f";
  const auto read = readFrom<UtraCellMeasResult>(encoded);
  EXPECT_EQ(textOf(*read), "[uarfcn: 127, band: 128, psc: 16384, ecno: 185, rscp: -64]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  UtraCellMeasResult written;
  EXPECT_NUMBER(uarfcn, Uarfcn, 127U);
  EXPECT_NUMBER(band, Band, 128U);
  EXPECT_NUMBER(psc, Psc, 16384U);
  EXPECT_NUMBER(ecno, Ecno, 185U);
  EXPECT_NUMBER(rscp, Rscp, -64);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
