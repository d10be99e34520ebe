// KCellularActivatedBearerContexts compared with the bytes of another encoder: every field is read, shown, written and
// cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/mobility/BearerContext.h"
#include "messages/mobility/KCellularActivatedBearerContexts.h"

namespace vespscope::test {
namespace {

TEST(KCellularActivatedBearerContexts, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 b5 88 86 fe ea 31 10 96 0a 1a 08 08 ad a0 01 30 07 50 01 1a 02 50 01";
  const auto read = readFrom<KCellularActivatedBearerContexts>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, bearer_context_count: 1302, bearer_contexts: [[cid: 20525, "
            "primary_dns_type: PDP_TYPE_NONE, is_addr_irat_mobile: 1], [is_addr_irat_mobile: 1]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularActivatedBearerContexts written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(bearerContextCount, BearerContextCount, 1302U);
  EXPECT_MESSAGES(bearerContexts, BearerContexts, bearerContexts, BearerContexts,
                  readAll<BearerContext>({"08 ad a0 01 30 07 50 01", "50 01"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
