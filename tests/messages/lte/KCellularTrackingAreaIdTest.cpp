// KCellularTrackingAreaId compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/KCellularTrackingAreaId.h"

namespace vespscope::test {
namespace {

TEST(KCellularTrackingAreaId, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "0a 03 62 f2 10 10 00";
  const auto read = readFrom<KCellularTrackingAreaId>(encoded);
  EXPECT_EQ(textOf(*read), "[encoded_plmn: <62 f2 10>, tac: 0]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularTrackingAreaId written;
  EXPECT_CONTENT(encodedPlmn, EncodedPlmn, hex("62 f2 10"));
  EXPECT_NUMBER(tac, Tac, 0U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
