// Events made of UMTS records.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "LiteralRecords.h"
#include "Mapping.h"
#include "sources/diag/WcdmaRecords.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;
using testing::ElementsAre;
using testing::IsEmpty;

class WcdmaRecordsMapping : public MappingTest {};

TEST_F(WcdmaRecordsMapping, TheCellIsReported) {
  EXPECT_THAT(take(wcdmaCellCode, literal::wcdmaCell),
              ElementsAre("KCellularWcdmaCellInfo[timestamp: 1000, mcc: 310, mnc: 260, lac: 7145, cell_id: 16909060, "
                          "wcdma_band: SYS_BAND_WCDMA_II_PCS_1900, dl_uarfcn: 9890, psc: 293, num_mnc_digits: 3]"));
}

TEST_F(WcdmaRecordsMapping, TheConnectionIsFollowedThroughItsMessages) {
  EXPECT_THAT(take(wcdmaRrcCode, "00 00 0c 00 39 00 00 00 01 31 09 30 0d f4 b5 24", 1000),
              ElementsAre("KCellularWcdmaRrcConnectionState[timestamp: 1000, state: KWCDMA_RRC_CONN_STATE_ESTABLISH, "
                          "establishment_cause: KRRC_EST_DETACH]"));
  EXPECT_THAT(take(wcdmaRrcCode, "02 00 0f 00 30 00 60 00 00 00 00 00 00 00 7f ff ff ff a0", 1100), IsEmpty());
  EXPECT_THAT(take(wcdmaRrcCode, "01 02 01 00 48", 1200),
              ElementsAre("KCellularWcdmaRrcConnectionState[timestamp: 1200, state: KWCDMA_RRC_CONN_STATE_CELL_FACH]"));
  EXPECT_THAT(take(wcdmaRrcCode, "01 02 01 00 00", 1300),
              ElementsAre("KCellularWcdmaRrcConnectionState[timestamp: 1300, state: KWCDMA_RRC_CONN_STATE_CELL_DCH]"));
  EXPECT_THAT(take(wcdmaRrcCode, "03 01 04 00 3e 31 0c 00", 1400),
              ElementsAre("KCellularWcdmaRrcConnectionState[timestamp: 1400, state: KWCDMA_RRC_CONN_STATE_RELEASE, "
                          "release_cause: KRRC_REL_NORMAL_EVENT]"));
  EXPECT_THAT(take(wcdmaRrcCode, "01 01 02 00 44 00", 1500),
              ElementsAre("KCellularWcdmaRrcConnectionState[timestamp: 1500, state: KWCDMA_RRC_CONN_STATE_IDLE, "
                          "release_cause: KRRC_REL_NORMAL_EVENT]"));
  // Its repetitions are not reported.
  EXPECT_THAT(take(wcdmaRrcCode, "01 01 02 00 44 00", 1600), IsEmpty());
}

TEST_F(WcdmaRecordsMapping, ASetupThatWasNotUnderstoodLeavesTheStateOpen) {
  EXPECT_THAT(take(wcdmaRrcCode, "01 02 01 00 48"), IsEmpty());
}

TEST_F(WcdmaRecordsMapping, ADirectTransferReachesTheRegistration) {
  EXPECT_THAT(take(wcdmaRrcCode, "03 03 06 00 14 20 04 10 08 16"),
              ElementsAre("KCellularGmmContext[timestamp: 1000, reg_status: KREG_STATUS_REGISTRATION_FAILURE, "
                          "proc_failure_cause: KNAS_MM_PROC_FAILURE_CAUSE_REJECTED_BY_NW, reject_cause: "
                          "KNAS_MM_REJ_CAUSE_PLMN_NOT_ALLOWED]"));
}

TEST_F(WcdmaRecordsMapping, BroadcastsAreCountedByTheirChannel) {
  take(wcdmaRrcCode, "84 28 1f 00 a2 26");
  take(wcdmaRrcCode, "fe 28 01 00 00");
  take(wcdmaRrcCode, "01 02 01 00 00");
  EXPECT_EQ(report_.read, (RecordCounts{{{0x412F, {}, {}}, 1}}));
  EXPECT_EQ(report_.skipped, (RecordCounts{{{0x412F, {}, 0x84}, 1}, {{0x412F, {}, 0xFE}, 1}}));
}

}  // namespace
}  // namespace vespscope::test
