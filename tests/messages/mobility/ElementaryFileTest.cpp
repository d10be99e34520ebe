// ElementaryFile compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/mobility/ElementaryFile.h"

namespace vespscope::test {
namespace {

TEST(ElementaryFile, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 80 01 12 03 62 f2 10";
  const auto read = readFrom<ElementaryFile>(encoded);
  EXPECT_EQ(textOf(*read), "[ef_id: 128, content: <62 f2 10>]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  ElementaryFile written;
  EXPECT_NUMBER(efId, EfId, 128U);
  EXPECT_CONTENT(content, Content, hex("62 f2 10"));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
