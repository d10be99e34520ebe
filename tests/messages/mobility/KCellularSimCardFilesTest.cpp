// KCellularSimCardFiles compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/mobility/ElementaryFile.h"
#include "messages/mobility/KCellularSimCardFiles.h"

namespace vespscope::test {
namespace {

TEST(KCellularSimCardFiles, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 81 d0 95 ff bc 31 12 08 08 7f 12 04 08 29 26 10 12 05 12 03 13 00 14";
  const auto read = readFrom<KCellularSimCardFiles>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, ef_list: [[ef_id: 127, content: <08 29 26 10>], [content: <13 00 14>]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularSimCardFiles written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_MESSAGES(efLists, EfLists, efList, EfList,
                  readAll<ElementaryFile>({"08 7f 12 04 08 29 26 10", "12 03 13 00 14"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
