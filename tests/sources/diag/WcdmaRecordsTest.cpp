// UMTS records of literal bytes, and the events made of them.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Mapping.h"
#include "sources/diag/WcdmaRecords.h"
#include "sources/diag/WcdmaRrcMeaning.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;
using testing::ElementsAre;
using testing::IsEmpty;
using Channel = WcdmaChannel;
using Event = WcdmaRrcEvent;

// UARFCNs 9490 and 9890, cell identity, URA, flags, access, PSC 293, 310-260, LAC 7145, RAC 18.
constexpr const char* cell =
    "12 25 00 00 a2 26 00 00 04 03 02 01 00 00 07 00 50 12 03 01 00 02 06 00 e9 1b 00 00 12 00 00 00";

TEST(WcdmaCellRecord, IsRead) {
  EXPECT_EQ(std::get<WcdmaCellRecord>(wcdmaCellOf(bytesOf(cell))),
            (WcdmaCellRecord{.uplinkUarfcn = 9490,
                             .downlinkUarfcn = 9890,
                             .cellIdentity = 0x01020304,
                             .primaryScramblingCode = 293,
                             .plmn = radio::Plmn::fromText("310260"),
                             .locationAreaCode = 7145,
                             .routingAreaCode = 18}));
}

TEST(WcdmaCellRecord, ANetworkCodeMayHaveTwoDigitsOrNone) {
  Bytes bytes = bytesOf(cell);
  bytes[23] = 0x0F;
  EXPECT_EQ(std::get<WcdmaCellRecord>(wcdmaCellOf(bytes)).plmn, radio::Plmn::fromText("31026"));
  bytes[18] = 0xFF;
  EXPECT_FALSE(std::get<WcdmaCellRecord>(wcdmaCellOf(bytes)).plmn);
}

TEST(WcdmaCellRecord, ImpossibleNumbersAndCutRecordsAreFaults) {
  Bytes bytes = bytesOf(cell);
  for (std::size_t length = 0; length < bytes.size(); ++length) {
    EXPECT_EQ(std::get<RecordFault>(wcdmaCellOf(std::span(bytes).first(length))), RecordFault::tooShort);
  }
  bytes[17] = 0x20;
  EXPECT_EQ(std::get<RecordFault>(wcdmaCellOf(bytes)), RecordFault::outOfRange);
}

TEST(WcdmaRrcRecord, HasOneOfFourChannels) {
  const Bytes bytes = bytesOf("03 02 02 00 44 20 ff");
  const auto record = std::get<WcdmaRrcRecord>(wcdmaRrcOf(bytes));
  EXPECT_EQ(record.channel, Channel::downlinkDcch);
  EXPECT_EQ(record.radioBearer, 2);
  EXPECT_EQ(Bytes(record.message.begin(), record.message.end()), bytesOf("44 20"));
  EXPECT_EQ(std::get<RecordFault>(wcdmaRrcOf(bytesOf("84 28 00 00"))), RecordFault::unknownVersion);
  EXPECT_EQ(std::get<RecordFault>(wcdmaRrcOf(bytesOf("03 02 03 00 44 20"))), RecordFault::tooShort);
  EXPECT_EQ(std::get<RecordFault>(wcdmaRrcOf(bytesOf("03 02"))), RecordFault::tooShort);
  EXPECT_EQ(std::get<RecordFault>(wcdmaRrcOf({})), RecordFault::tooShort);
}

std::optional<WcdmaRrcMeaning> meaningOf(Channel channel, std::string_view dump) {
  return wcdmaRrcMeaningOf(channel, bytesOf(dump));
}

TEST(WcdmaRrcMeaning, ARequestTellsItsCauseBehindTheIdentity) {
  // A TMSI with a network code of three digits, cause 13.
  EXPECT_EQ(meaningOf(Channel::uplinkCcch, "39 00 00 00 01 31 09 30 0d f4 b5 24")->cause, 13U);
  // An IMSI of 15 digits, cause 12.
  EXPECT_EQ(meaningOf(Channel::uplinkCcch, "20 93 10 26 00 12 34 56 78 60")->event, Event::connectionRequest);
  EXPECT_EQ(meaningOf(Channel::uplinkCcch, "20 93 10 26 00 12 34 56 78 60")->cause, 12U);
  // Cut in the identity.
  EXPECT_FALSE(meaningOf(Channel::uplinkCcch, "39 00 00")->cause);
}

TEST(WcdmaRrcMeaning, ASetupTellsTheStateThatItGrants) {
  // Release 99 without any optional part, an IMEI, CELL_FACH.
  const auto first = meaningOf(Channel::downlinkCcch, "30 00 60 00 00 00 00 00 00 00 7f ff ff ff a0");
  ASSERT_TRUE(first);
  EXPECT_EQ(first->event, Event::connectionSetup);
  EXPECT_EQ(first->state, 1U);
}

TEST(WcdmaRrcMeaning, ReleaseAndRejectTellTheirCauses) {
  // Release 4's form with the number of answers, normal event.
  EXPECT_EQ(meaningOf(Channel::downlinkDcch, "3e 31 0c 00")->event, Event::connectionRelease);
  EXPECT_EQ(meaningOf(Channel::downlinkDcch, "3e 31 0c 00")->cause, 0U);
  // Release 99's form without it, user inactivity.
  EXPECT_EQ(meaningOf(Channel::downlinkDcch, "3c 0c")->cause, 6U);
  // An IMEI, unspecified; and the same with a redirection.
  const auto reject = meaningOf(Channel::downlinkCcch, "10 c0 00 00 00 00 00 00 00 80");
  ASSERT_TRUE(reject);
  EXPECT_EQ(reject->event, Event::connectionReject);
  EXPECT_EQ(reject->cause, 1U);
  EXPECT_FALSE(reject->redirected);
  EXPECT_TRUE(meaningOf(Channel::downlinkCcch, "12 c0 00 00 00 00 00 00 00 80")->redirected);
}

TEST(WcdmaRrcMeaning, ACellUpdateTellsWhetherTheRadioLinkFailed) {
  EXPECT_EQ(meaningOf(Channel::uplinkCcch, "03 ff ff ff fc 00 00 00 40")->event, Event::cellUpdate);
  EXPECT_EQ(meaningOf(Channel::uplinkCcch, "03 ff ff ff fc 00 00 01 40")->event, Event::radioLinkFailure);
  EXPECT_FALSE(meaningOf(Channel::uplinkCcch, "03 ff ff ff fc"));
}

TEST(WcdmaRrcMeaning, IntegrityProtectionIsSkipped) {
  EXPECT_EQ(meaningOf(Channel::uplinkDcch, "44 00")->event, Event::connectionReleaseComplete);
  EXPECT_EQ(meaningOf(Channel::uplinkDcch, "ff ff ff ff f4 40")->event, Event::connectionReleaseComplete);
}

TEST(WcdmaRrcMeaning, DirectTransfersCarryTheirMessage) {
  const auto downlink = meaningOf(Channel::downlinkDcch, "14 20 04 10 08 16");
  ASSERT_TRUE(downlink);
  EXPECT_EQ(downlink->event, Event::directTransfer);
  EXPECT_EQ(downlink->nasMessage, bytesOf("08 04 0b"));
  EXPECT_FALSE(meaningOf(Channel::downlinkDcch, "14 20 04 10 08"));
  const auto uplink = meaningOf(Channel::uplinkDcch, "6c 00 08 28 58");
  ASSERT_TRUE(uplink);
  EXPECT_EQ(uplink->nasMessage, bytesOf("05 0b"));
  const auto initial = meaningOf(Channel::uplinkDcch, "14 80 00 00 08 40 a8");
  ASSERT_TRUE(initial);
  EXPECT_EQ(initial->nasMessage, bytesOf("08 15"));
}

TEST(WcdmaRrcMeaning, OtherMessagesTellNothing) {
  EXPECT_FALSE(meaningOf(Channel::uplinkDcch, ""));
  EXPECT_FALSE(meaningOf(Channel::uplinkDcch, "20"));
  EXPECT_FALSE(meaningOf(Channel::downlinkDcch, "22 4e"));
  EXPECT_FALSE(meaningOf(Channel::downlinkCcch, "70"));
  EXPECT_FALSE(meaningOf(Channel::uplinkCcch, "60"));
  EXPECT_FALSE(meaningOf(Channel::uplinkDcch, "ff ff"));
}

class WcdmaRecordsMapping : public MappingTest {};

TEST_F(WcdmaRecordsMapping, TheCellIsReported) {
  EXPECT_THAT(take(wcdmaCellCode, cell),
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
  // Its repetitions are no news.
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
