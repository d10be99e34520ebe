// Guti compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/Guti.h"

namespace vespscope::test {
namespace {

TEST(Guti, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 96 0a 10 ad a0 01 18 94 2d";
  const auto read = readFrom<Guti>(encoded);
  EXPECT_EQ(textOf(*read), "[mmegi: 1302, mmec: 20525, m_tmsi: 5780]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  Guti written;
  EXPECT_NUMBER(mmegi, Mmegi, 1302U);
  EXPECT_NUMBER(mmec, Mmec, 20525U);
  EXPECT_NUMBER(mTmsi, MTmsi, 5780U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
