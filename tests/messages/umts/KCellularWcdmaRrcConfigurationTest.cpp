// KCellularWcdmaRrcConfiguration compared with the bytes of another encoder: every field is read, shown, written and
// cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/umts/KCellularWcdmaRrcConfiguration.h"

namespace vespscope::test {
namespace {

TEST(KCellularWcdmaRrcConfiguration, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 b5 88 86 fe ea 31 10 80 80 04 18 00 20 01";
  const auto read = readFrom<KCellularWcdmaRrcConfiguration>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, drx_cycle_length_ms: 65536, is_mimo_configured: 0, is_dc_configured: 1]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularWcdmaRrcConfiguration written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(drxCycleLengthMs, DrxCycleLengthMs, 65536U);
  EXPECT_NUMBER(isMimoConfigured, IsMimoConfigured, false);
  EXPECT_NUMBER(isDcConfigured, IsDcConfigured, true);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
