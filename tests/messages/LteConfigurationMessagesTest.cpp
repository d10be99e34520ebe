// Every LTE state and configuration message against bytes of another encoder: each field read, shown, written, taken
// away.
#include <gtest/gtest.h>

#include "MessageTesting.h"
#include "messages/lte/Guti.h"
#include "messages/lte/KCellularEmmContext.h"
#include "messages/lte/KCellularLteCdrxConfig.h"
#include "messages/lte/KCellularLteRrcState.h"
#include "messages/lte/KCellularLteScellInfo.h"
#include "messages/lte/KCellularLteSelReselCellInfo.h"
#include "messages/lte/KCellularTrackingAreaId.h"
#include "messages/lte/NbrEutra.h"

namespace vespscope {
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

TEST(KCellularLteCdrxConfig, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 81 d0 95 ff bc 31 10 ad a0 01 18 94 2d 20 00 28 80 80 04 38 7f 50 80 01 58 80 80 01 60 07 68 b9 01 70 "
      "ff ff ff ff 0f";
  const auto read = readFrom<KCellularLteCdrxConfig>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, cell_status: 20525, on_duration_ms: 5780, drx_inactivity_ms: 0, "
            "drx_retx_timer_ms: 65536, long_drx_cycle_ms: 127, short_drx_cycle_ms: 128, drx_short_cycle_num: "
            "16384, rrc_state: (unknown: 7), cdrx_config_status: 185, transmission_mode: 4294967295]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteCdrxConfig written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_NUMBER(cellStatus, CellStatus, 20525U);
  EXPECT_NUMBER(onDurationMs, OnDurationMs, 5780U);
  EXPECT_NUMBER(drxInactivityMs, DrxInactivityMs, 0U);
  EXPECT_NUMBER(drxRetxTimerMs, DrxRetxTimerMs, 65536U);
  EXPECT_NUMBER(longDrxCycleMs, LongDrxCycleMs, 127U);
  EXPECT_NUMBER(shortDrxCycleMs, ShortDrxCycleMs, 128U);
  EXPECT_NUMBER(drxShortCycleNum, DrxShortCycleNum, 16384U);
  EXPECT_NUMBER(rrcState, RrcState, 7);
  EXPECT_NUMBER(cdrxConfigStatus, CdrxConfigStatus, 185U);
  EXPECT_NUMBER(transmissionMode, TransmissionMode, 4294967295U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularLteScellInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 81 d0 95 ff bc 31 10 ac 02 18 96 0a 20 ad a0 01 28 94 2d 30 00 38 80 80 04 40 7f 48 80 01 50 80 80 01 "
      "58 b9 01 60 ff ff ff ff 0f 70 07 78 ac 02";
  const auto read = readFrom<KCellularLteScellInfo>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, phy_cell_id: 300, dl_freq: 1302, ul_freq: 20525, dl_bw: 5780, ul_bw: 0, "
            "cell_id: 65536, freq_band_ind: 127, tracking_area_code: 128, num_mnc_digits: 16384, sel_plmn_mcc: "
            "185, sel_plmn_mnc: 4294967295, tdd_sf_assignment: 7, tdd_ssf_patterns: 300]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteScellInfo written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_NUMBER(phyCellId, PhyCellId, 300U);
  EXPECT_NUMBER(dlFreq, DlFreq, 1302U);
  EXPECT_NUMBER(ulFreq, UlFreq, 20525U);
  EXPECT_NUMBER(dlBw, DlBw, 5780U);
  EXPECT_NUMBER(ulBw, UlBw, 0U);
  EXPECT_NUMBER(cellId, CellId, 65536U);
  EXPECT_NUMBER(freqBandInd, FreqBandInd, 127U);
  EXPECT_NUMBER(trackingAreaCode, TrackingAreaCode, 128U);
  EXPECT_NUMBER(numMncDigits, NumMncDigits, 16384U);
  EXPECT_NUMBER(selPlmnMcc, SelPlmnMcc, 185U);
  EXPECT_NUMBER(selPlmnMnc, SelPlmnMnc, 4294967295U);
  EXPECT_NUMBER(tddSfAssignment, TddSfAssignment, 7U);
  EXPECT_NUMBER(tddSsfPatterns, TddSsfPatterns, 300U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularLteSelReselCellInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 81 d0 95 ff bc 31 12 04 04 14 ac 02 18 ad a0 01 20 94 2d 28 00 30 80 80 04 38 7f 40 80 01 48 80 80 01 "
      "50 b9 01 58 01 60 bd 01 68 ff ff ff ff 0f 70 07 78 ac 02 80 01 96 0a 88 01 ad a0 01 90 01 94 2d 98 01 00 "
      "a0 01 80 80 04 aa 01 09 08 7f 38 80 01 68 80 80 01 aa 01 03 68 b9 01";
  const auto read = readFrom<KCellularLteSelReselCellInfo>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, multi_band_info: [4, 20, 300], ims_emergency_support: 20525, "
            "ac_barring_for_emergency: 5780, mo_signalling_ac_barring_factor: 0, mo_signalling_ac_barring_time: "
            "65536, mo_signalling_ac_barring_for_special_ac: 127, mo_data_ac_barring_factor: 128, "
            "mo_data_ac_barring_time: 16384, mo_data_ac_barring_for_special_ac: 185, QRxLevMin: -1, QQualMin: "
            "-95, Q_hyst: 4294967295, S_non_intra_search_P: 7, S_non_intra_search_Q: 300, S_intra_search_P: "
            "1302, S_intra_search_Q: 20525, Thresh_serving_lowP: 5780, priority_operating_freq: 65536, "
            "nbr_eutra: [[earfcn: 127, Thres_X_highP: 128, band: 16384], [band: 185]]]");
  // All but field 19, whose number is a metric tag: it is written but never read.
  EXPECT_EQ(
      read->encoded(),
      hex("08 81 d0 95 ff bc 31 12 04 04 14 ac 02 18 ad a0 01 20 94 2d 28 00 30 80 80 04 38 7f 40 80 01 48 80 80 01 "
          "50 b9 01 58 01 60 bd 01 68 ff ff ff ff 0f 70 07 78 ac 02 80 01 96 0a 88 01 ad a0 01 90 01 94 2d a0 01 80 "
          "80 04 aa 01 09 08 7f 38 80 01 68 80 80 01 aa 01 03 68 b9 01"));

  KCellularLteSelReselCellInfo written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_NUMBERS(multiBandInfos, MultiBandInfos, multiBandInfo, MultiBandInfo, <std::uint32_t>{4, 20, 300});
  EXPECT_NUMBER(imsEmergencySupport, ImsEmergencySupport, 20525U);
  EXPECT_NUMBER(acBarringForEmergency, AcBarringForEmergency, 5780U);
  EXPECT_NUMBER(moSignallingAcBarringFactor, MoSignallingAcBarringFactor, 0U);
  EXPECT_NUMBER(moSignallingAcBarringTime, MoSignallingAcBarringTime, 65536U);
  EXPECT_NUMBER(moSignallingAcBarringForSpecialAc, MoSignallingAcBarringForSpecialAc, 127U);
  EXPECT_NUMBER(moDataAcBarringFactor, MoDataAcBarringFactor, 128U);
  EXPECT_NUMBER(moDataAcBarringTime, MoDataAcBarringTime, 16384U);
  EXPECT_NUMBER(moDataAcBarringForSpecialAc, MoDataAcBarringForSpecialAc, 185U);
  EXPECT_NUMBER(qRxLevMin, QRxLevMin, -1);
  EXPECT_NUMBER(qQualMin, QQualMin, -95);
  EXPECT_NUMBER(qHyst, QHyst, 4294967295U);
  EXPECT_NUMBER(sNonIntraSearchP, SNonIntraSearchP, 7U);
  EXPECT_NUMBER(sNonIntraSearchQ, SNonIntraSearchQ, 300U);
  EXPECT_NUMBER(sIntraSearchP, SIntraSearchP, 1302U);
  EXPECT_NUMBER(sIntraSearchQ, SIntraSearchQ, 20525U);
  EXPECT_NUMBER(threshServingLowP, ThreshServingLowP, 5780U);
  EXPECT_FALSE(read->hasThreshServingLowQ());
  written.setThreshServingLowQ(0U);
  EXPECT_TRUE(written.hasThreshServingLowQ());
  EXPECT_EQ(written.threshServingLowQ(), 0U);
  EXPECT_NUMBER(priorityOperatingFreq, PriorityOperatingFreq, 65536U);
  EXPECT_MESSAGES(nbrEutras, NbrEutras, nbrEutra, NbrEutra,
                  readAll<NbrEutra>({"08 7f 38 80 01 68 80 80 01", "68 b9 01"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(NbrEutra, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 ff ff ff ff 0f 10 18 18 ff 09 20 fe ff ff ff 0f 28 7e 30 07 38 ac 02 40 96 0a 48 ad a0 01 50 94 2d 58 "
      "00 60 01 68 80 80 04";
  const auto read = readFrom<NbrEutra>(encoded);
  EXPECT_EQ(textOf(*read),
            "[earfcn: 4294967295, Q_rxlev_min: 12, Q_qual_min: -640, Q_offset: 2147483647, Pmax: 63, dl_bw: 7, "
            "Thres_X_highP: 300, Thres_X_lowP: 1302, Thres_X_highQ: 20525, Thres_X_lowQ: 5780, priority: 0, "
            "frame_type: TDD, band: 65536]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  NbrEutra written;
  EXPECT_NUMBER(earfcn, Earfcn, 4294967295U);
  EXPECT_NUMBER(qRxlevMin, QRxlevMin, 12);
  EXPECT_NUMBER(qQualMin, QQualMin, -640);
  EXPECT_NUMBER(qOffset, QOffset, 2147483647);
  EXPECT_NUMBER(pmax, Pmax, 63);
  EXPECT_NUMBER(dlBw, DlBw, 7U);
  EXPECT_NUMBER(thresXHighP, ThresXHighP, 300U);
  EXPECT_NUMBER(thresXLowP, ThresXLowP, 1302U);
  EXPECT_NUMBER(thresXHighQ, ThresXHighQ, 20525U);
  EXPECT_NUMBER(thresXLowQ, ThresXLowQ, 5780U);
  EXPECT_NUMBER(priority, Priority, 0U);
  EXPECT_NUMBER(frameType, FrameType, 1);
  EXPECT_NUMBER(band, Band, 65536U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

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

TEST(Guti, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 96 0a 10 ad a0 01 18 94 2d";
  const auto read = readFrom<Guti>(encoded);
  EXPECT_EQ(textOf(*read), "[mmegi: 1302, mmec: 20525, m_tmsi: 5780]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  Guti written;
  EXPECT_NUMBER(mmegi, Mmegi, 1302U);
  EXPECT_NUMBER(mmec, Mmec, 20525U);
  EXPECT_NUMBER(mTmsi, MTmsi, 5780U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularTrackingAreaId, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "0a 03 62 f2 10 10 00";
  const auto read = readFrom<KCellularTrackingAreaId>(encoded);
  EXPECT_EQ(textOf(*read), "[encoded_plmn: <62 f2 10>, tac: 0]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularTrackingAreaId written;
  EXPECT_CONTENT(encodedPlmn, EncodedPlmn, hex("62 f2 10"));
  EXPECT_NUMBER(tac, Tac, 0U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope
