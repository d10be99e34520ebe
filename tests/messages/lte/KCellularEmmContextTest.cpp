// KCellularEmmContext compared with the bytes of another encoder: every field is read, shown, written and cleared.
#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/lte/Guti.h"
#include "messages/lte/KCellularEmmContext.h"
#include "messages/lte/KCellularTrackingAreaId.h"

namespace vespscope::test {
namespace {

TEST(KCellularEmmContext, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 10 00 18 ff ff ff ff ff ff ff ff ff 01 20 03 2a 08 0a 03 13 00 14 10 80 01 2a 04 10 "
      "80 80 01 32 0b 08 b9 01 10 ff ff ff ff 0f 18 07 38 02 40 04 48 ac 02 50 01 58 00";
  const auto read = readFrom<KCellularEmmContext>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, reg_status: KREG_STATUS_NORMAL_SERVICE, update_status: (unknown: -1), "
            "ue_op_mode: EPS_UE_OP_MODE_CSPS_MODE_2, tai_list: [[encoded_plmn: <13 00 14>, tac: 128], [tac: "
            "16384]], guti: [mmegi: 185, mmec: 4294967295, m_tmsi: 7], reject_cause: "
            "EMM_CAUSE_IMSI_UNKNOWN_IN_HSS, reg_proc: EMM_PROC_TAU, t3412_dur_s: 300, is_ims_voice_supported: 1, "
            "is_emerg_bearer_supported: 0]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularEmmContext written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(regStatus, RegStatus, 0);
  EXPECT_NUMBER(updateStatus, UpdateStatus, -1);
  EXPECT_NUMBER(ueOpMode, UeOpMode, 3);
  EXPECT_MESSAGES(taiLists, TaiLists, taiList, TaiList,
                  readAll<KCellularTrackingAreaId>({"0a 03 13 00 14 10 80 01", "10 80 80 01"}));
  EXPECT_MESSAGE(guti, Guti, readFrom<Guti>("08 b9 01 10 ff ff ff ff 0f 18 07"));
  EXPECT_NUMBER(rejectCause, RejectCause, 2);
  EXPECT_NUMBER(regProc, RegProc, 4);
  EXPECT_NUMBER(t3412DurS, T3412DurS, 300U);
  EXPECT_NUMBER(isImsVoiceSupported, IsImsVoiceSupported, true);
  EXPECT_NUMBER(isEmergBearerSupported, IsEmergBearerSupported, false);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope::test
