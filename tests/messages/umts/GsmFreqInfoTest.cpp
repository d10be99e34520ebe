// GsmFreqInfo compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/umts/GsmFreqInfo.h"

namespace vespscope::test {
namespace {

TEST(GsmFreqInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 ff ff ff ff 0f 10 07";
  const auto read = readFrom<GsmFreqInfo>(encoded);
  EXPECT_EQ(textOf(*read), "[arfcn: 4294967295, prio: 7]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  GsmFreqInfo written;
  EXPECT_NUMBER(arfcn, Arfcn, 4294967295U);
  EXPECT_NUMBER(prio, Prio, 7U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
