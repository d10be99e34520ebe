// GsmCellMeasResult compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/umts/GsmCellMeasResult.h"

namespace vespscope::test {
namespace {

TEST(GsmCellMeasResult, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 ff ff ff ff 0f 10 07 18 ac 02";
  const auto read = readFrom<GsmCellMeasResult>(encoded);
  EXPECT_EQ(textOf(*read), "[arfcn: 4294967295, bsic: 7, rxlev: 300]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  GsmCellMeasResult written;
  EXPECT_NUMBER(arfcn, Arfcn, 4294967295U);
  EXPECT_NUMBER(bsic, Bsic, 7U);
  EXPECT_NUMBER(rxlev, Rxlev, 300U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
