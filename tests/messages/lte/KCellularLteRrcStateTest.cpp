// KCellularLteRrcState compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/KCellularLteRrcState.h"

namespace vespscope::test {
namespace {

TEST(KCellularLteRrcState, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 81 d0 95 ff bc 31 10 06 18 01 20 ac 02 28 10";
  const auto read = readFrom<KCellularLteRrcState>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, state: KLTE_RRC_STATE_ATMPT_INBND_MOBILITY, prev_state: "
            "KLTE_RRC_STATE_IDLE, prev_state_dur_ms: 300, cause: KLTE_RRC_CAUSE_REL_CSFB_HIGH_PRIO]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteRrcState written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_NUMBER(state, State, 6);
  EXPECT_NUMBER(prevState, PrevState, 1);
  EXPECT_NUMBER(prevStateDurMs, PrevStateDurMs, 300U);
  EXPECT_NUMBER(cause, Cause, 16);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
