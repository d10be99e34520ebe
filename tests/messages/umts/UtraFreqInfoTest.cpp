// UtraFreqInfo compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/umts/UtraFreqInfo.h"

namespace vespscope::test {
namespace {

TEST(UtraFreqInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 80 80 01 10 b9 01";
  const auto read = readFrom<UtraFreqInfo>(encoded);
  EXPECT_EQ(textOf(*read), "[uarfcn: 16384, prio: 185]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  UtraFreqInfo written;
  EXPECT_NUMBER(uarfcn, Uarfcn, 16384U);
  EXPECT_NUMBER(prio, Prio, 185U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
