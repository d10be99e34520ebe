// KCellularWcdmaRrcConnectionState compared with the bytes of another encoder: every field is read, shown, written and
// cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/umts/KCellularWcdmaRrcConnectionState.h"

namespace vespscope::test {
namespace {

TEST(KCellularWcdmaRrcConnectionState, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 81 d0 95 ff bc 31 10 09 18 00 20 ff ff ff ff ff ff ff ff ff 01";
  const auto read = readFrom<KCellularWcdmaRrcConnectionState>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, state: KWCDMA_RRC_CONN_STATE_RADIO_LINK_FAILURE, establishment_cause: "
            "KRRC_EST_ORIG_CONV_CALL, release_cause: (unknown: -1)]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularWcdmaRrcConnectionState written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_NUMBER(state, State, 9);
  EXPECT_NUMBER(establishmentCause, EstablishmentCause, 0);
  EXPECT_NUMBER(releaseCause, ReleaseCause, -1);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
