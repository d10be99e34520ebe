// KCellularGmmContext compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/mobility/KCellularGmmContext.h"
#include "messages/mobility/RoutingAreaId.h"

namespace vespscope::test {
namespace {

TEST(KCellularGmmContext, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 81 d0 95 ff bc 31 10 06 18 03 22 17 0a 10 fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01 18 7f 20 80 "
      "01 28 80 80 01 30 b9 01 38 0e 40 00 48 ff ff ff ff ff ff ff ff ff 01";
  const auto read = readFrom<KCellularGmmContext>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, reg_status: KREG_STATUS_SERVICE_DETACHED, update_status: (unknown: 3), "
            "rai: [encoded_plmn: <fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01>, lac: 127, rac: 128], p_tmsi: "
            "16384, t3312_dur_s: 185, proc_failure_cause: KNAS_MM_PROC_FAILURE_CAUSE_TIMEOUT, reject_cause: "
            "KNAS_MM_REJ_CAUSE_NONE, reg_proc: (unknown: -1)]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularGmmContext written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_NUMBER(regStatus, RegStatus, 6);
  EXPECT_NUMBER(updateStatus, UpdateStatus, 3);
  EXPECT_MESSAGE(rai, Rai,
                 readFrom<RoutingAreaId>("0a 10 fe 80 00 00 00 00 00 00 00 00 00 00 00 00 00 01 18 7f 20 80 01"));
  EXPECT_NUMBER(pTmsi, PTmsi, 16384U);
  EXPECT_NUMBER(t3312DurS, T3312DurS, 185U);
  EXPECT_NUMBER(procFailureCause, ProcFailureCause, 14);
  EXPECT_NUMBER(rejectCause, RejectCause, 0);
  EXPECT_NUMBER(regProc, RegProc, -1);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
