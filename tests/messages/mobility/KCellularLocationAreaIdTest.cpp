// KCellularLocationAreaId compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/mobility/KCellularLocationAreaId.h"

namespace vespscope::test {
namespace {

TEST(KCellularLocationAreaId, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "0a 03 62 f2 10 10 ac 02";
  const auto read = readFrom<KCellularLocationAreaId>(encoded);
  EXPECT_EQ(textOf(*read), "[encoded_plmn: <62 f2 10>, lac: 300]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLocationAreaId written;
  EXPECT_CONTENT(encodedPlmn, EncodedPlmn, hex("62 f2 10"));
  EXPECT_NUMBER(lac, Lac, 300U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
