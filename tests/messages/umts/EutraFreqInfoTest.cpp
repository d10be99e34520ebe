// EutraFreqInfo compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/umts/EutraFreqInfo.h"

namespace vespscope::test {
namespace {

TEST(EutraFreqInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 7f 10 80 01";
  const auto read = readFrom<EutraFreqInfo>(encoded);
  EXPECT_EQ(textOf(*read), "[earfcn: 127, prio: 128]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  EutraFreqInfo written;
  EXPECT_NUMBER(earfcn, Earfcn, 127U);
  EXPECT_NUMBER(prio, Prio, 128U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
