// EgwErrcNbrUtraMeas compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/EgwErrcNbrUtraMeas.h"

namespace vespscope::test {
namespace {

TEST(EgwErrcNbrUtraMeas, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 b9 01 10 ff ff ff ff 0f 18 7f 20 07";
  const auto read = readFrom<EgwErrcNbrUtraMeas>(encoded);
  EXPECT_EQ(textOf(*read), "[uarfcn: 185, psc: 4294967295, rscp: -64, ecno: 7]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  EgwErrcNbrUtraMeas written;
  EXPECT_NUMBER(uarfcn, Uarfcn, 185U);
  EXPECT_NUMBER(psc, Psc, 4294967295U);
  EXPECT_NUMBER(rscp, Rscp, -64);
  EXPECT_NUMBER(ecno, Ecno, 7U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
