// Plmn compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/mobility/Plmn.h"

namespace vespscope::test {
namespace {

TEST(Plmn, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "0a 03 13 00 14";
  const auto read = readFrom<Plmn>(encoded);
  EXPECT_EQ(textOf(*read), "[encoded_plmn: <13 00 14>]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  Plmn written;
  EXPECT_CONTENT(encodedPlmn, EncodedPlmn, hex("13 00 14"));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
