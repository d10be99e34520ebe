// RoutingAreaId compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/mobility/RoutingAreaId.h"

namespace vespscope::test {
namespace {

TEST(RoutingAreaId, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "0a 04 08 29 26 10 18 ff ff ff ff 0f 20 07";
  const auto read = readFrom<RoutingAreaId>(encoded);
  EXPECT_EQ(textOf(*read), "[encoded_plmn: <08 29 26 10>, lac: 4294967295, rac: 7]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  RoutingAreaId written;
  EXPECT_CONTENT(encodedPlmn, EncodedPlmn, hex("08 29 26 10"));
  EXPECT_NUMBER(lac, Lac, 4294967295U);
  EXPECT_NUMBER(rac, Rac, 7U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
