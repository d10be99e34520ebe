// KCellularMmContext compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/mobility/KCellularLocationAreaId.h"
#include "messages/mobility/KCellularMmContext.h"

namespace vespscope::test {
namespace {

TEST(KCellularMmContext, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 81 d0 95 ff bc 31 10 00 18 ff ff ff ff ff ff ff ff ff 01 22 06 0a 00 10 ad a0 01 28 94 2d 30 00 38 0f "
      "40 02 48 00";
  const auto read = readFrom<KCellularMmContext>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, reg_status: KREG_STATUS_NORMAL_SERVICE, update_status: (unknown: -1), "
            "lai: [encoded_plmn: <>, lac: 20525], tmsi: 5780, t3212_dur_s: 0, proc_failure_cause: "
            "KNAS_MM_PROC_FAILURE_CAUSE_OTHER, reject_cause: KNAS_MM_REJ_CAUSE_IMSI_UNKNOWN, is_combined_proc: 0]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularMmContext written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_NUMBER(regStatus, RegStatus, 0);
  EXPECT_NUMBER(updateStatus, UpdateStatus, -1);
  EXPECT_MESSAGE(lai, Lai, readFrom<KCellularLocationAreaId>("0a 00 10 ad a0 01"));
  EXPECT_NUMBER(tmsi, Tmsi, 5780U);
  EXPECT_NUMBER(t3212DurS, T3212DurS, 0U);
  EXPECT_NUMBER(procFailureCause, ProcFailureCause, 15);
  EXPECT_NUMBER(rejectCause, RejectCause, 2);
  EXPECT_NUMBER(isCombinedProc, IsCombinedProc, false);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
