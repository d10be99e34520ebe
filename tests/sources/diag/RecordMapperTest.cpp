// Records become events, and values that the modem omits stay absent.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Bytes.h"
#include "LiteralRecords.h"
#include "Mapping.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;
using testing::ElementsAre;
using testing::IsEmpty;

class RecordMapperTest : public MappingTest {
 protected:
  std::vector<std::string> takeRrc(std::uint8_t type, std::string_view message, std::int64_t time,
                                   std::string_view cell = "b9 00 94 16 00 00") {
    Bytes payload = bytesOf("08 09 0a 01");
    append(payload, bytesOf(cell));
    append(payload, bytesOf("34 12"));
    payload.push_back(type);
    append(payload, bytesOf("00 00 00 00"));
    const Bytes content = bytesOf(message);
    payload.push_back(static_cast<std::uint8_t>(content.size()));
    payload.push_back(0);
    append(payload, content);
    return take(rrcMessageCode, payload, time);
  }

  static constexpr std::uint8_t downlinkCcch = 5;
  static constexpr std::uint8_t downlinkDcch = 6;
  static constexpr std::uint8_t uplinkCcch = 7;
  static constexpr std::uint8_t uplinkDcch = 8;
};

Bytes measurementOf(std::uint32_t earfcn, std::uint8_t cellIndex) {
  Bytes bytes = bytesOf(literal::measurementV19);
  bytes[8] = static_cast<std::uint8_t>(earfcn & 0xFF);
  bytes[9] = static_cast<std::uint8_t>(earfcn >> 8);
  bytes[17] = static_cast<std::uint8_t>(0xF0 | cellIndex << 1);
  return bytes;
}

constexpr const char* levels = "phy_cell_id: 185, rsrp0: -113, rsrp1: -110, rsrq0: -9, rsrq1: -9, sinr0: 10, sinr1: 9";

std::string levelsAt(int time, int cells) {
  std::string text = "KCellularLteRsrpRsrqSinr[timestamp: " + std::to_string(time) + ", inst_values: [";
  for (int cell = 0; cell < cells; ++cell) text += (cell > 0 ? ", [" : "[") + std::string(levels) + "]";
  return text + "]]";
}
const char* const namedCell = "phy_cell_id: 185, dl_freq: 5780, freq_band_ind: 17]";
const char* const activeSecondary =
    "[index: 1, state: SCC_STATE_ACTIVATED, pci: 185, dl_earfcn: 700, dl_rf_band: 2, rsrp: -10950, rsrq: -888, snr: 5, "
    "rssi: -8325]";
const char* const goneSecondary = "[index: 1, state: SCC_STATE_DECONFIGURED, pci: 185, dl_earfcn: 700, dl_rf_band: 2]";

TEST_F(RecordMapperTest, AServingCellRecordBecomesServingCellInfo) {
  EXPECT_THAT(take(servingCellCode, bytesOf(literal::servingCellV3), 1000),
              ElementsAre("KCellularLteScellInfo[timestamp: 1000, phy_cell_id: 185, dl_freq: 5780, ul_freq: 23780, "
                          "dl_bw: 20, ul_bw: 10, cell_id: 67305985, freq_band_ind: 17, tracking_area_code: 4660, "
                          "num_mnc_digits: 3, sel_plmn_mcc: 310, sel_plmn_mnc: 410]",
                          "KCellularLteComponentCarrierInfo[timestamp: 1000, pcc_earfcn: 5780, pcc_bandwidth: 10]"));
  EXPECT_THAT(take(servingCellCode, bytesOf(literal::servingCellV2), 2000),
              ElementsAre("KCellularLteScellInfo[timestamp: 2000, phy_cell_id: 503, dl_freq: 1300, ul_freq: 19300, "
                          "dl_bw: 40, ul_bw: 30, cell_id: 268435455, freq_band_ind: 3, tracking_area_code: 65534, "
                          "num_mnc_digits: 2, sel_plmn_mcc: 262, sel_plmn_mnc: 1]",
                          "KCellularLteComponentCarrierInfo[timestamp: 2000, pcc_earfcn: 1300, pcc_bandwidth: 20]"));
}

TEST_F(RecordMapperTest, ResourceBlocksBecomeHalfMegahertz) {
  struct Case {
    std::uint8_t blocks;
    const char* text;
  };
  for (const Case& item : {Case{6, "dl_bw: 3, "}, Case{15, "dl_bw: 6, "}, Case{25, "dl_bw: 10, "},
                           Case{50, "dl_bw: 20, "}, Case{75, "dl_bw: 30, "}, Case{100, "dl_bw: 40, "}}) {
    Bytes bytes = bytesOf(literal::servingCellV3);
    bytes[11] = item.blocks;
    EXPECT_THAT(take(servingCellCode, bytes, 1000), testing::Contains(testing::HasSubstr(item.text)));
  }
}

TEST_F(RecordMapperTest, WhatNoCellCanHaveIsAbsentFromServingCellInfo) {
  Bytes bytes = bytesOf(literal::servingCellV3);
  bytes[11] = 27;    // not the blocks of a channel bandwidth
  bytes[16] = 0x10;  // a cell identity of 29 bits
  bytes[24] = 0xFF;  // a country code of 65334
  EXPECT_THAT(take(servingCellCode, bytes, 1000),
              ElementsAre("KCellularLteScellInfo[timestamp: 1000, phy_cell_id: 185, dl_freq: 5780, ul_freq: 23780, "
                          "ul_bw: 10, freq_band_ind: 17, tracking_area_code: 4660]"));
}

TEST_F(RecordMapperTest, AMeasurementNamesTheServingCellThatNothingDescribed) {
  EXPECT_THAT(take(servingMeasurementCode, measurementOf(5780, 0), 1000),
              ElementsAre(std::string("KCellularLteScellInfo[timestamp: 1000, ") + namedCell,
                          "KCellularLteComponentCarrierInfo[timestamp: 1000, pcc_earfcn: 5780]", levelsAt(1000, 1)));
  EXPECT_THAT(take(servingMeasurementCode, measurementOf(5780, 0), 1010), ElementsAre(levelsAt(1010, 1)));
}

TEST_F(RecordMapperTest, ACellOutsideEveryBandHasNone) {
  EXPECT_THAT(take(servingMeasurementCode, measurementOf(5400, 0), 1000),
              testing::Contains("KCellularLteScellInfo[timestamp: 1000, phy_cell_id: 185, dl_freq: 5400]"));
}

TEST_F(RecordMapperTest, AMeasurementOfTheDescribedCellDoesNotReplaceItsDescription) {
  take(servingCellCode, bytesOf(literal::servingCellV3), 1000);
  EXPECT_THAT(take(servingMeasurementCode, measurementOf(5780, 0), 1010), ElementsAre(levelsAt(1010, 1)));
}

TEST_F(RecordMapperTest, TheDescriptionComesBackAfterLateNewsOfTheCellBefore) {
  take(servingCellCode, bytesOf(literal::servingCellV3), 1000);
  EXPECT_THAT(take(servingMeasurementCode, measurementOf(700, 0), 1010),
              testing::Contains("KCellularLteScellInfo[timestamp: 1010, phy_cell_id: 185, dl_freq: 700, "
                                "freq_band_ind: 2]"));
  EXPECT_THAT(
      take(servingMeasurementCode, measurementOf(5780, 0), 1020),
      testing::Contains(testing::HasSubstr("timestamp: 1020, phy_cell_id: 185, dl_freq: 5780, ul_freq: 23780")));
  take(servingMeasurementCode, measurementOf(700, 0), 1030);
  EXPECT_THAT(take(servingMeasurementCode, measurementOf(5780, 0), 4001),
              testing::Contains(std::string("KCellularLteScellInfo[timestamp: 4001, ") + namedCell));
}

TEST_F(RecordMapperTest, ASecondaryJoinsTheLevelsBehindThePrimary) {
  EXPECT_THAT(take(servingMeasurementCode, measurementOf(700, 1), 990),
              ElementsAre(std::string("KCellularLteCarrierAggregationStatus[timestamp: 990, scc_list: [") +
                          activeSecondary + "]]"));
  EXPECT_THAT(take(servingMeasurementCode, measurementOf(5780, 0), 1000),
              ElementsAre(std::string("KCellularLteScellInfo[timestamp: 1000, ") + namedCell,
                          "KCellularLteComponentCarrierInfo[timestamp: 1000, pcc_earfcn: 5780, scc0_earfcn: 700]",
                          levelsAt(1000, 2)));
}

TEST_F(RecordMapperTest, PrimaryAndSecondariesInOneRecordGiveOneReportOfLevels) {
  Bytes bytes = measurementOf(5780, 0);
  for (const auto& secondary : {measurementOf(2000, 2), measurementOf(700, 1)}) {
    bytes.insert(bytes.end(), secondary.begin() + 4, secondary.end());
    ++bytes[1];
  }
  const auto events = take(servingMeasurementCode, bytes, 1000);
  ASSERT_EQ(events.size(), 4U);
  EXPECT_EQ(events[1],
            "KCellularLteComponentCarrierInfo[timestamp: 1000, pcc_earfcn: 5780, scc0_earfcn: 700, "
            "scc1_earfcn: 2000]");
  EXPECT_EQ(events[2], levelsAt(1000, 3));
  EXPECT_THAT(events[3], testing::HasSubstr(std::string("scc_list: [") + activeSecondary + ", [index: 2, "));
}

TEST_F(RecordMapperTest, LevelsOfASecondaryCountForASecond) {
  take(servingMeasurementCode, measurementOf(5780, 0), 1000);
  take(servingMeasurementCode, measurementOf(700, 1), 1000);
  EXPECT_THAT(take(servingMeasurementCode, measurementOf(5780, 0), 2000), ElementsAre(levelsAt(2000, 2)));
  EXPECT_THAT(take(servingMeasurementCode, measurementOf(5780, 0), 2001), ElementsAre(levelsAt(2001, 1)));
}

TEST_F(RecordMapperTest, ASecondaryNotMeasuredForThreeSecondsIsDeconfiguredOnce) {
  take(servingMeasurementCode, measurementOf(5780, 0), 1000);
  take(servingMeasurementCode, measurementOf(700, 1), 1000);
  EXPECT_THAT(take(servingMeasurementCode, measurementOf(5780, 0), 4000), ElementsAre(levelsAt(4000, 1)));
  // A record of any code shows that time has passed.
  EXPECT_THAT(take(0x1234, {}, 4010),
              ElementsAre("KCellularLteComponentCarrierInfo[timestamp: 4010, pcc_earfcn: 5780]",
                          std::string("KCellularLteCarrierAggregationStatus[timestamp: 4010, scc_list: [") +
                              goneSecondary + "]]"));
  EXPECT_THAT(take(servingMeasurementCode, measurementOf(5780, 0), 4020), ElementsAre(levelsAt(4020, 1)));
}

TEST_F(RecordMapperTest, TheSecondaryThatRemainsIsListedBeforeTheOneThatIsGone) {
  take(servingMeasurementCode, measurementOf(700, 1), 1000);
  take(servingMeasurementCode, measurementOf(2000, 2), 3000);
  EXPECT_THAT(take(0x1234, {}, 4010),
              ElementsAre(testing::AllOf(testing::HasSubstr("[index: 2, state: SCC_STATE_ACTIVATED"),
                                         testing::EndsWith(std::string(", ") + goneSecondary + "]]"))));
}

TEST_F(RecordMapperTest, AReleaseDeconfiguresTheSecondariesAtOnce) {
  takeRrc(uplinkDcch, "10 00", 900);
  take(servingMeasurementCode, measurementOf(700, 1), 1000);
  EXPECT_THAT(takeRrc(downlinkDcch, "2a 02", 1500),
              ElementsAre("KCellularLteRrcState[timestamp: 1500, state: KLTE_RRC_STATE_IDLE, prev_state: "
                          "KLTE_RRC_STATE_CONNECTED, prev_state_dur_ms: 600, cause: KLTE_RRC_CAUSE_REL_OTHER]",
                          "KCellularLteComponentCarrierInfo[timestamp: 1500, pcc_earfcn: 5780]",
                          std::string("KCellularLteCarrierAggregationStatus[timestamp: 1500, scc_list: [") +
                              goneSecondary + "]]"));
}

TEST_F(RecordMapperTest, ACellThatDoesNotServeIsLeftOut) {
  Bytes bytes = measurementOf(5780, 0);
  bytes[17] = 0xE0;
  EXPECT_THAT(take(servingMeasurementCode, bytes, 1000), IsEmpty());
}

TEST_F(RecordMapperTest, AnAntennaThatDidNotMeasureIsAbsent) {
  Bytes bytes = measurementOf(5780, 0);
  for (std::size_t position = 36; position < 40; ++position) bytes[position] = 0;  // RSRP1 of -180 dBm
  EXPECT_THAT(
      take(servingMeasurementCode, bytes, 1000),
      testing::Contains("KCellularLteRsrpRsrqSinr[timestamp: 1000, inst_values: [[phy_cell_id: 185, rsrp0: -113, "
                        "rsrq0: -9, sinr0: 10]]]"));
}

TEST_F(RecordMapperTest, NeighboursBecomeReportingCodes) {
  // -118.5 dBm rounds away from zero to -119: code 21; -18.0625 dB: code 3.
  EXPECT_THAT(take(neighbourMeasurementCode, bytesOf(literal::neighboursV4), 1000),
              ElementsAre("KCellularLteNbrEutraCellMeas[timestamp: 1000, meas_nbr_eutra: [[nbr_earfcn: 5780, "
                          "nbr_phys_cell_id: 210, freq_band_ind: 17, nbr_rsrp: 21, nbr_rsrq: 3], [nbr_earfcn: 5780, "
                          "nbr_phys_cell_id: 503, freq_band_ind: 17, nbr_rsrp: 19, nbr_rsrq: 0]]]"));
}

TEST_F(RecordMapperTest, NeighboursOfAllCarriersMeasuredLatelyAreOneList) {
  Bytes other = bytesOf(literal::neighboursV4);
  other[8] = 0xBC;
  other[9] = 0x02;
  take(neighbourMeasurementCode, other, 1000);
  const auto both = take(neighbourMeasurementCode, bytesOf(literal::neighboursV4), 4000);
  ASSERT_EQ(both.size(), 1U);
  EXPECT_THAT(both[0], testing::AllOf(testing::HasSubstr("nbr_earfcn: 700"), testing::HasSubstr("nbr_earfcn: 5780")));
  const auto one = take(neighbourMeasurementCode, bytesOf(literal::neighboursV4), 4001);
  ASSERT_EQ(one.size(), 1U);
  EXPECT_THAT(one[0], testing::Not(testing::HasSubstr("nbr_earfcn: 700")));
}

TEST_F(RecordMapperTest, TheConnectionIsFollowedThroughItsStates) {
  EXPECT_THAT(takeRrc(uplinkCcch, "40 00 00 00 00 08", 1000),
              ElementsAre(std::string("KCellularLteScellInfo[timestamp: 1000, ") + namedCell,
                          "KCellularLteRrcState[timestamp: 1000, state: KLTE_RRC_STATE_ATMPT_CONNECTION, cause: "
                          "KLTE_RRC_CAUSE_EST_MO_DATA]"));
  EXPECT_THAT(takeRrc(downlinkCcch, "70 12", 1050), IsEmpty());
  EXPECT_THAT(takeRrc(uplinkDcch, "24 00", 1060),
              ElementsAre("KCellularLteRrcState[timestamp: 1060, state: KLTE_RRC_STATE_CONNECTED, prev_state: "
                          "KLTE_RRC_STATE_ATMPT_CONNECTION, prev_state_dur_ms: 60]"));
  EXPECT_THAT(takeRrc(downlinkDcch, "22 10", 1070), IsEmpty());
  EXPECT_THAT(takeRrc(uplinkDcch, "08 10", 1080), IsEmpty());
  EXPECT_THAT(takeRrc(uplinkCcch, "00 00 00 00 00 04", 2060),
              ElementsAre("KCellularLteRrcState[timestamp: 2060, state: KLTE_RRC_STATE_ATMPT_CONNECTION, prev_state: "
                          "KLTE_RRC_STATE_CONNECTED, prev_state_dur_ms: 1000, cause: KLTE_RRC_CAUSE_REEST_HO_FAIL]"));
  EXPECT_THAT(takeRrc(uplinkDcch, "18 00", 2100),
              ElementsAre("KCellularLteRrcState[timestamp: 2100, state: KLTE_RRC_STATE_CONNECTED, prev_state: "
                          "KLTE_RRC_STATE_ATMPT_CONNECTION, prev_state_dur_ms: 40]"));
  EXPECT_THAT(takeRrc(downlinkDcch, "28 00", 3100),
              ElementsAre("KCellularLteRrcState[timestamp: 3100, state: KLTE_RRC_STATE_IDLE, prev_state: "
                          "KLTE_RRC_STATE_CONNECTED, prev_state_dur_ms: 1000, cause: "
                          "KLTE_RRC_CAUSE_REL_LOAD_BAL_TAU_REQD]"));
}

TEST_F(RecordMapperTest, RejectionsLeadToIdleWithACause) {
  takeRrc(uplinkCcch, "40 00 00 00 00 06", 1000);
  EXPECT_THAT(takeRrc(downlinkCcch, "40", 1100),
              ElementsAre("KCellularLteRrcState[timestamp: 1100, state: KLTE_RRC_STATE_IDLE, prev_state: "
                          "KLTE_RRC_STATE_ATMPT_CONNECTION, prev_state_dur_ms: 100, cause: "
                          "KLTE_RRC_CAUSE_EST_FAIL_REJ]"));
  takeRrc(uplinkCcch, "00 00 00 00 00 00", 1200);
  EXPECT_THAT(takeRrc(downlinkCcch, "20", 1300),
              ElementsAre("KCellularLteRrcState[timestamp: 1300, state: KLTE_RRC_STATE_IDLE, prev_state: "
                          "KLTE_RRC_STATE_ATMPT_CONNECTION, prev_state_dur_ms: 100, cause: "
                          "KLTE_RRC_CAUSE_REL_CONN_FAIL_REEST_REJ]"));
}

TEST_F(RecordMapperTest, MobilityToAnotherTechnologyIsAnAttempt) {
  takeRrc(uplinkDcch, "24 00", 1000);
  EXPECT_THAT(takeRrc(downlinkDcch, "1a 00", 1500),
              ElementsAre("KCellularLteRrcState[timestamp: 1500, state: KLTE_RRC_STATE_ATMPT_OUTBND_MOBILITY, "
                          "prev_state: KLTE_RRC_STATE_CONNECTED, prev_state_dur_ms: 500]"));
}

TEST_F(RecordMapperTest, ASecondAttemptIsNewsOfItsOwn) {
  takeRrc(uplinkCcch, "40 00 00 00 00 06", 1000);
  EXPECT_THAT(takeRrc(uplinkCcch, "40 00 00 00 00 04", 1200),
              ElementsAre("KCellularLteRrcState[timestamp: 1200, state: KLTE_RRC_STATE_ATMPT_CONNECTION, prev_state: "
                          "KLTE_RRC_STATE_ATMPT_CONNECTION, prev_state_dur_ms: 200, cause: "
                          "KLTE_RRC_CAUSE_EST_MT_ACC]"));
}

TEST_F(RecordMapperTest, CausesWithoutANameAreAbsent) {
  EXPECT_THAT(takeRrc(uplinkCcch, "40 00 00 00 00 0c", 1000),
              testing::Contains("KCellularLteRrcState[timestamp: 1000, state: KLTE_RRC_STATE_ATMPT_CONNECTION]"));
}

TEST_F(RecordMapperTest, ADedicatedMessageInALogThatBeganLateShowsAConnection) {
  EXPECT_THAT(takeRrc(downlinkDcch, "22 10", 1000),
              testing::Contains("KCellularLteRrcState[timestamp: 1000, state: KLTE_RRC_STATE_CONNECTED]"));
}

TEST_F(RecordMapperTest, AHandoverShowsInTheMessagesOfTheNewCell) {
  takeRrc(uplinkDcch, "08 10", 1000);
  EXPECT_THAT(
      takeRrc(uplinkDcch, "10 00", 1020, "fe 00 b7 16 00 00"),
      ElementsAre("KCellularLteScellInfo[timestamp: 1020, phy_cell_id: 254, dl_freq: 5815, freq_band_ind: 17]"));
}

TEST_F(RecordMapperTest, BroadcastsNameNoServingCell) {
  for (const std::uint8_t type : Bytes{1, 2, 3, 9}) EXPECT_THAT(takeRrc(type, "40 00", 1000), IsEmpty());
}

TEST_F(RecordMapperTest, NothingIsRememberedAcrossALongSilence) {
  takeRrc(uplinkDcch, "24 00", 1000);
  EXPECT_THAT(takeRrc(downlinkDcch, "2a 02", 61'001),
              ElementsAre(std::string("KCellularLteScellInfo[timestamp: 61001, ") + namedCell,
                          "KCellularLteRrcState[timestamp: 61001, state: KLTE_RRC_STATE_IDLE, cause: "
                          "KLTE_RRC_CAUSE_REL_OTHER]"));
}

TEST_F(RecordMapperTest, ASilenceOfAMinuteIsPartOfTheStory) {
  takeRrc(uplinkDcch, "24 00", 1000);
  EXPECT_THAT(takeRrc(downlinkDcch, "2a 02", 61'000), ElementsAre(testing::HasSubstr("prev_state_dur_ms: 60000")));
}

TEST_F(RecordMapperTest, NothingIsRememberedWhenTheClockStepsBack) {
  takeRrc(uplinkDcch, "24 00", 5000);
  EXPECT_THAT(takeRrc(downlinkDcch, "2a 02", 3999),
              testing::Contains("KCellularLteRrcState[timestamp: 3999, state: KLTE_RRC_STATE_IDLE, cause: "
                                "KLTE_RRC_CAUSE_REL_OTHER]"));
}

TEST_F(RecordMapperTest, ALittleDisorderCostsOnlyTheDuration) {
  takeRrc(uplinkDcch, "24 00", 5000);
  EXPECT_THAT(takeRrc(downlinkDcch, "2a 02", 4990),
              ElementsAre("KCellularLteRrcState[timestamp: 4990, state: KLTE_RRC_STATE_IDLE, prev_state: "
                          "KLTE_RRC_STATE_CONNECTED, cause: KLTE_RRC_CAUSE_REL_OTHER]"));
}

TEST_F(RecordMapperTest, NeighboursOfIdleAndConnectedModeAreOneList) {
  EXPECT_THAT(take(connectedNeighboursCode, bytesOf(literal::connectedNeighbours), 1000),
              ElementsAre("KCellularLteNbrEutraCellMeas[timestamp: 1000, meas_nbr_eutra: [[nbr_earfcn: 5780, "
                          "nbr_phys_cell_id: 210, freq_band_ind: 17, nbr_rsrp: 21, nbr_rsrq: 3], [nbr_earfcn: 5780, "
                          "nbr_phys_cell_id: 503, freq_band_ind: 17, nbr_rsrp: 19, nbr_rsrq: 0]]]"));
  EXPECT_THAT(take(idleNeighboursCode, bytesOf(literal::idleNeighbours), 1500),
              ElementsAre(testing::HasSubstr("meas_nbr_eutra: [[nbr_earfcn: 1300, nbr_phys_cell_id: 1, freq_band_ind: "
                                             "3, nbr_rsrp: 40, nbr_rsrq: 19], [nbr_earfcn: 5780")));
}

TEST_F(RecordMapperTest, EveryRecordIsCountedForWhatBecameOfIt) {
  take(servingCellCode, bytesOf(literal::servingCellV3), 1000);
  take(servingCellCode, bytesOf("03 b9"), 1000);
  take(servingCellCode, bytesOf("07 b9"), 1000);
  take(servingCellCode, {}, 1000);
  take(servingMeasurementCode, bytesOf("01 01 00 00 1a 13 04 00"), 1000);
  take(0xB0C1, bytesOf("02"), 1000);
  take(0xB0C1, bytesOf("03"), 1000);
  take(connectedNeighboursCode, bytesOf("01 02 00 00 1f 04 0c 00 94 16 00 00 00 00 00 00 1e 03 04 00"), 1000);
  EXPECT_EQ(report_.read, (RecordCounts{{{0xB0C2, 3, {}}, 1}, {{0xB195, 1, {}}, 1}}));
  EXPECT_EQ(report_.partsSkipped, (RecordCounts{{{0xB195, 3, 30}, 1}}));
  EXPECT_EQ(report_.skipped, (RecordCounts{{{0xB0C1, {}, {}}, 2}, {{0xB0C2, 7, {}}, 1}, {{0xB193, 19, 26}, 1}}));
  EXPECT_EQ(report_.broken, (RecordCounts{{{0xB0C2, {}, {}}, 1}, {{0xB0C2, 3, {}}, 1}}));
  EXPECT_EQ(report_.text(),
            "0 frames, 2 records read, 4 skipped (B0C1: 2, B0C2 v7: 1, B193 subpacket 26 v19: 1), 2 broken (B0C2: 1, "
            "B0C2 v3: 1), 1 parts skipped (B195 subpacket 30 v3: 1)");
}

}  // namespace
}  // namespace vespscope::test
