// Every GSM message against bytes of another encoder: each field read, shown, written, taken away.
#include <gtest/gtest.h>

#include "MessageTesting.h"
#include "messages/gsm/GsmNcellMeas.h"
#include "messages/gsm/KCellularGsmCsRfMeasurement.h"
#include "messages/gsm/KCellularGsmGprsConfig.h"
#include "messages/gsm/KCellularGsmGrrEventMeasCr.h"
#include "messages/gsm/KCellularGsmIdleConfig.h"
#include "messages/gsm/KCellularGsmIdleScellMeasurement.h"
#include "messages/gsm/KCellularGsmScellInfo.h"
#include "messages/gsm/LteNcellMeas.h"
#include "messages/gsm/UmtsNcellMeas.h"

namespace vespscope {
namespace {

TEST(KCellularGsmScellInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 20 80 80 04 28 7f 30 80 01 38 80 80 01 40 a9 01 48 b9 01 50 ff ff ff ff 0f 58 01 68 07";
  const auto read = readFrom<KCellularGsmScellInfo>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, mcc: 65536, mnc: 127, lac: 128, cell_id: 16384, gsm_band: (unknown: "
            "169), arfcn: 185, bsic: 4294967295, state: DEDICATED_STATE, num_mnc_digits: 7]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularGsmScellInfo written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(mcc, Mcc, 65536U);
  EXPECT_NUMBER(mnc, Mnc, 127U);
  EXPECT_NUMBER(lac, Lac, 128U);
  EXPECT_NUMBER(cellId, CellId, 16384U);
  EXPECT_NUMBER(gsmBand, GsmBand, 169);
  EXPECT_NUMBER(arfcn, Arfcn, 185U);
  EXPECT_NUMBER(bsic, Bsic, 4294967295U);
  EXPECT_NUMBER(state, State, 1);
  EXPECT_NUMBER(numMncDigits, NumMncDigits, 7U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularGsmIdleConfig, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 10 96 0a 18 ad a0 01 20 94 2d 28 00 30 80 80 04 38 7f 40 80 01 48 80 80 01 50 b9 01 "
      "58 ff ff ff ff 0f 60 07 68 ac 02 70 96 0a 78 ad a0 01 80 01 94 2d 88 01 00 90 01 80 80 04 98 01 7f a0 01 "
      "80 01 a8 01 80 80 01 b0 01 b9 01 b8 01 ff ff ff ff 0f c0 01 07 c8 01 ac 02 d0 01 96 0a d8 01 ad a0 01 e0 "
      "01 94 2d e8 01 00 f0 01 80 80 04 f8 01 7f 80 02 80 01 88 02 80 80 01 90 02 b9 01";
  const auto read = readFrom<KCellularGsmIdleConfig>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, arfcn_bcch: 1302, mcc: 20525, mnc: 5780, lac: 0, ci: 65536, bsic: 127, "
            "dtx_from_bs: 128, radio_link_timeout: 16384, multib_rep: 185, gsm_band: 4294967295, access_tech: 7, "
            "type_of_cur_chan: 300, ms_txpwr: 1302, rx_acc_min: 20525, cbq: 5780, cba: 0, c2_valid: 65536, "
            "tmp_offset: 128, penalty_t: 16384, t3212: 185, acc: 4294967295, bs_pa_mfrms: 7, cs_pagemode: 300, "
            "max_retrans_cs: 1302, emerg_call_allowed: 20525, attach_allowed: 5780, half_rate_supported: 0, "
            "si_7_8_broadcast: 65536, cbch_supported: 127, reest_allowed: 128, ecsc: 16384, si_2_ter_needed: 185]");
  // All but field 19, whose number is a metric tag: it is written but never read.
  EXPECT_EQ(
      read->encoded(),
      hex("08 b5 88 86 fe ea 31 10 96 0a 18 ad a0 01 20 94 2d 28 00 30 80 80 04 38 7f 40 80 01 48 80 80 01 50 b9 01 "
          "58 ff ff ff ff 0f 60 07 68 ac 02 70 96 0a 78 ad a0 01 80 01 94 2d 88 01 00 90 01 80 80 04 a0 01 80 01 a8 "
          "01 80 80 01 b0 01 b9 01 b8 01 ff ff ff ff 0f c0 01 07 c8 01 ac 02 d0 01 96 0a d8 01 ad a0 01 e0 01 94 2d "
          "e8 01 00 f0 01 80 80 04 f8 01 7f 80 02 80 01 88 02 80 80 01 90 02 b9 01"));

  KCellularGsmIdleConfig written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(arfcnBcch, ArfcnBcch, 1302U);
  EXPECT_NUMBER(mcc, Mcc, 20525U);
  EXPECT_NUMBER(mnc, Mnc, 5780U);
  EXPECT_NUMBER(lac, Lac, 0U);
  EXPECT_NUMBER(ci, Ci, 65536U);
  EXPECT_NUMBER(bsic, Bsic, 127U);
  EXPECT_NUMBER(dtxFromBs, DtxFromBs, 128U);
  EXPECT_NUMBER(radioLinkTimeout, RadioLinkTimeout, 16384U);
  EXPECT_NUMBER(multibRep, MultibRep, 185U);
  EXPECT_NUMBER(gsmBand, GsmBand, 4294967295U);
  EXPECT_NUMBER(accessTech, AccessTech, 7U);
  EXPECT_NUMBER(typeOfCurChan, TypeOfCurChan, 300U);
  EXPECT_NUMBER(msTxpwr, MsTxpwr, 1302U);
  EXPECT_NUMBER(rxAccMin, RxAccMin, 20525U);
  EXPECT_NUMBER(cbq, Cbq, 5780U);
  EXPECT_NUMBER(cba, Cba, 0U);
  EXPECT_NUMBER(c2Valid, C2Valid, 65536U);
  EXPECT_FALSE(read->hasCrOffset());
  written.setCrOffset(127U);
  EXPECT_TRUE(written.hasCrOffset());
  EXPECT_EQ(written.crOffset(), 127U);
  EXPECT_NUMBER(tmpOffset, TmpOffset, 128U);
  EXPECT_NUMBER(penaltyT, PenaltyT, 16384U);
  EXPECT_NUMBER(t3212, T3212, 185U);
  EXPECT_NUMBER(acc, Acc, 4294967295U);
  EXPECT_NUMBER(bsPaMfrms, BsPaMfrms, 7U);
  EXPECT_NUMBER(csPagemode, CsPagemode, 300U);
  EXPECT_NUMBER(maxRetransCs, MaxRetransCs, 1302U);
  EXPECT_NUMBER(emergCallAllowed, EmergCallAllowed, 20525U);
  EXPECT_NUMBER(attachAllowed, AttachAllowed, 5780U);
  EXPECT_NUMBER(halfRateSupported, HalfRateSupported, 0U);
  EXPECT_NUMBER(si78Broadcast, Si78Broadcast, 65536U);
  EXPECT_NUMBER(cbchSupported, CbchSupported, 127U);
  EXPECT_NUMBER(reestAllowed, ReestAllowed, 128U);
  EXPECT_NUMBER(ecsc, Ecsc, 16384U);
  EXPECT_NUMBER(si2TerNeeded, Si2TerNeeded, 185U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularGsmGprsConfig, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 10 00 18 07 20 01 28 ac 02 30 96 0a 38 ad a0 01 40 94 2d 48 01 50 00 58 80 80 04";
  const auto read = readFrom<KCellularGsmGprsConfig>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, gprs_sup: 0, rac: 7, sp_pg_cy: 1, nco: 300, nom: 1302, cr_hyst: 20525, "
            "acc_thr: 5780, ext_upl_tbf_supported: 1, priority_class: 0, cell_bar_access_2: 65536]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularGsmGprsConfig written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(gprsSup, GprsSup, false);
  EXPECT_NUMBER(rac, Rac, 7U);
  EXPECT_NUMBER(spPgCy, SpPgCy, true);
  EXPECT_NUMBER(nco, Nco, 300U);
  EXPECT_NUMBER(nom, Nom, 1302U);
  EXPECT_NUMBER(crHyst, CrHyst, 20525U);
  EXPECT_NUMBER(accThr, AccThr, 5780U);
  EXPECT_NUMBER(extUplTbfSupported, ExtUplTbfSupported, true);
  EXPECT_NUMBER(priorityClass, PriorityClass, 0U);
  EXPECT_NUMBER(cellBarAccess2, CellBarAccess2, 65536U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularGsmIdleScellMeasurement, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 b5 88 86 fe ea 31 10 80 01 18 80 80 01 20 b9 01 28 bd 01";
  const auto read = readFrom<KCellularGsmIdleScellMeasurement>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, scell_arfcn: 128, simplified_l1_state: 16384, current_antenna: 185, "
            "idle_rxlev_dBm: -95]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularGsmIdleScellMeasurement written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(scellArfcn, ScellArfcn, 128U);
  EXPECT_NUMBER(simplifiedL1State, SimplifiedL1State, 16384U);
  EXPECT_NUMBER(currentAntenna, CurrentAntenna, 185U);
  EXPECT_NUMBER(idleRxlevDBm, IdleRxlevDBm, -95);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularGsmCsRfMeasurement, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 b5 88 86 fe ea 31 10 07 18 ac 02 20 96 0a 2a 03 01 02 42 30 ad a0 01 38 94 2d 40 00";
  const auto read = readFrom<KCellularGsmCsRfMeasurement>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, scell_arfcn: 7, simplified_l1_state: 300, current_antenna: 1302, "
            "cs_tx_pwr: [-1, 1, 33], cs_rxlev_sub: 20525, cs_rxqual_sub: 5780, scell_band: 0]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularGsmCsRfMeasurement written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(scellArfcn, ScellArfcn, 7U);
  EXPECT_NUMBER(simplifiedL1State, SimplifiedL1State, 300U);
  EXPECT_NUMBER(currentAntenna, CurrentAntenna, 1302U);
  EXPECT_NUMBERS(csTxPwrs, CsTxPwrs, csTxPwr, CsTxPwr, <std::int32_t>{-1, 1, 33});
  EXPECT_NUMBER(csRxlevSub, CsRxlevSub, 20525U);
  EXPECT_NUMBER(csRxqualSub, CsRxqualSub, 5780U);
  EXPECT_NUMBER(scellBand, ScellBand, 0U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularGsmGrrEventMeasCr, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 81 d0 95 ff bc 31 12 09 08 7f 20 80 01 38 80 80 01 12 03 38 b9 01 1a 12 08 ff ff ff ff 0f 10 07 18 ac "
      "02 20 96 0a 28 ad a0 01 1a 03 28 94 2d 22 0f 08 00 10 80 80 04 18 7f 20 80 01 28 80 80 01 22 03 28 b9 01";
  const auto read = readFrom<KCellularGsmGrrEventMeasCr>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, gsm_ncell_meas: [[mcc: 127, ci: 128, rxlev: 16384], [rxlev: 185]], "
            "umts_ncell_meas: [[cell_type: 4294967295, cpich_sc: 7, dl_uarfcn: 300, cpich_rscp: 1302, "
            "cpich_ecn0: 20525], [cpich_ecn0: 5780]], lte_ncell_meas: [[physical_cell_id: 0, bandwidth: 65536, "
            "rsrp: 127, earfcn: 128, rsrq: 16384], [rsrq: 185]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularGsmGrrEventMeasCr written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_MESSAGES(gsmNcellMeas, GsmNcellMeas, gsmNcellMeas, GsmNcellMeas,
                  readAll<GsmNcellMeas>({"08 7f 20 80 01 38 80 80 01", "38 b9 01"}));
  EXPECT_MESSAGES(umtsNcellMeas, UmtsNcellMeas, umtsNcellMeas, UmtsNcellMeas,
                  readAll<UmtsNcellMeas>({"08 ff ff ff ff 0f 10 07 18 ac 02 20 96 0a 28 ad a0 01", "28 94 2d"}));
  EXPECT_MESSAGES(lteNcellMeas, LteNcellMeas, lteNcellMeas, LteNcellMeas,
                  readAll<LteNcellMeas>({"08 00 10 80 80 04 18 7f 20 80 01 28 80 80 01", "28 b9 01"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(GsmNcellMeas, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 ff ff ff ff 0f 10 07 18 ac 02 20 96 0a 28 ad a0 01 30 94 2d 38 00";
  const auto read = readFrom<GsmNcellMeas>(encoded);
  EXPECT_EQ(textOf(*read), "[mcc: 4294967295, mnc: 7, lac: 300, ci: 1302, bsic: 20525, arfcn: 5780, rxlev: 0]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  GsmNcellMeas written;
  EXPECT_NUMBER(mcc, Mcc, 4294967295U);
  EXPECT_NUMBER(mnc, Mnc, 7U);
  EXPECT_NUMBER(lac, Lac, 300U);
  EXPECT_NUMBER(ci, Ci, 1302U);
  EXPECT_NUMBER(bsic, Bsic, 20525U);
  EXPECT_NUMBER(arfcn, Arfcn, 5780U);
  EXPECT_NUMBER(rxlev, Rxlev, 0U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(UmtsNcellMeas, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 80 80 04 10 7f 18 80 01 20 80 80 01 28 b9 01";
  const auto read = readFrom<UmtsNcellMeas>(encoded);
  EXPECT_EQ(textOf(*read), "[cell_type: 65536, cpich_sc: 127, dl_uarfcn: 128, cpich_rscp: 16384, cpich_ecn0: 185]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  UmtsNcellMeas written;
  EXPECT_NUMBER(cellType, CellType, 65536U);
  EXPECT_NUMBER(cpichSc, CpichSc, 127U);
  EXPECT_NUMBER(dlUarfcn, DlUarfcn, 128U);
  EXPECT_NUMBER(cpichRscp, CpichRscp, 16384U);
  EXPECT_NUMBER(cpichEcn0, CpichEcn0, 185U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(LteNcellMeas, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 ff ff ff ff 0f 10 07 18 ac 02 20 96 0a 28 ad a0 01";
  const auto read = readFrom<LteNcellMeas>(encoded);
  EXPECT_EQ(textOf(*read), "[physical_cell_id: 4294967295, bandwidth: 7, rsrp: 300, earfcn: 1302, rsrq: 20525]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  LteNcellMeas written;
  EXPECT_NUMBER(physicalCellId, PhysicalCellId, 4294967295U);
  EXPECT_NUMBER(bandwidth, Bandwidth, 7U);
  EXPECT_NUMBER(rsrp, Rsrp, 300U);
  EXPECT_NUMBER(earfcn, Earfcn, 1302U);
  EXPECT_NUMBER(rsrq, Rsrq, 20525U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope
