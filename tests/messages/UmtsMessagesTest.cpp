// Every UMTS message against bytes of another encoder: each field read, shown, written, taken away.
#include <limits>

#include <gtest/gtest.h>

#include "MessageTesting.h"
#include "messages/umts/EutraFreqInfo.h"
#include "messages/umts/GsmCellMeasResult.h"
#include "messages/umts/GsmFreqInfo.h"
#include "messages/umts/KCellularWcdmaCellInfo.h"
#include "messages/umts/KCellularWcdmaNbrCellMeas.h"
#include "messages/umts/KCellularWcdmaRrcConfiguration.h"
#include "messages/umts/KCellularWcdmaRrcConnectionState.h"
#include "messages/umts/KCellularWcdmaScellMeasurement.h"
#include "messages/umts/KCellularWcdmaSelReselCellInfo.h"
#include "messages/umts/KCellularWcdmaTxPower.h"
#include "messages/umts/LteCellMeasResult.h"
#include "messages/umts/UtraCellMeasResult.h"
#include "messages/umts/UtraFreqInfo.h"

namespace vespscope {
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

TEST(KCellularWcdmaRrcConfiguration, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 b5 88 86 fe ea 31 10 80 80 04 18 00 20 01";
  const auto read = readFrom<KCellularWcdmaRrcConfiguration>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, drx_cycle_length_ms: 65536, is_mimo_configured: 0, is_dc_configured: 1]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularWcdmaRrcConfiguration written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(drxCycleLengthMs, DrxCycleLengthMs, 65536U);
  EXPECT_NUMBER(isMimoConfigured, IsMimoConfigured, false);
  EXPECT_NUMBER(isDcConfigured, IsDcConfigured, true);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularWcdmaCellInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 20 80 01 28 80 80 01 30 b9 01 38 ff ff ff ff 0f 40 a8 01 48 07 50 ac 02 68 96 0a 70 01";
  const auto read = readFrom<KCellularWcdmaCellInfo>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, mcc: 128, mnc: 16384, lac: 185, cell_id: 4294967295, wcdma_band: "
            "SYS_BAND_UMTS_BAND6, dl_uarfcn: 7, psc: 300, num_mnc_digits: 1302, hspa: SYS_HS_IND_HSDPA_SUPP_CELL]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularWcdmaCellInfo written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(mcc, Mcc, 128U);
  EXPECT_NUMBER(mnc, Mnc, 16384U);
  EXPECT_NUMBER(lac, Lac, 185U);
  EXPECT_NUMBER(cellId, CellId, 4294967295U);
  EXPECT_NUMBER(wcdmaBand, WcdmaBand, 168);
  EXPECT_NUMBER(dlUarfcn, DlUarfcn, 7U);
  EXPECT_NUMBER(psc, Psc, 300U);
  EXPECT_NUMBER(numMncDigits, NumMncDigits, 1302U);
  EXPECT_NUMBER(hspa, Hspa, 1);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularWcdmaSelReselCellInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 10 94 2d 18 00 20 01 2a 04 04 14 ac 02 30 80 80 04 38 7f 40 80 01 48 ff ff ff ff 0f "
      "50 01 58 bd 01 60 18 68 ff 09 a8 01 80 80 01 b2 01 09 08 b9 01 10 ff ff ff ff 0f b2 01 02 10 07 ba 01 06 "
      "08 ac 02 10 96 0a ba 01 04 10 ad a0 01 c2 01 05 08 94 2d 10 00 c2 01 04 10 80 80 04";
  const auto read = readFrom<KCellularWcdmaSelReselCellInfo>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, hsdpa_capable: 5780, edch_capable: 0, duplex_mode: TDD, multi_band_info: "
            "[4, 20, 300], ims_emergency_support: 65536, cell_barred: 127, fach_meas_occ_info_present: 128, "
            "s_rxlev: -2147483648, s_qual: -1, s_intrasearch: -95, s_intersearch: 12, s_search_rat: -640, "
            "s_cell_prio: 16384, eutra_prio_info: [[earfcn: 185, prio: 4294967295], [prio: 7]], utra_prio_info: "
            "[[uarfcn: 300, prio: 1302], [prio: 20525]], gsm_prio_info: [[arfcn: 5780, prio: 0], [prio: 65536]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularWcdmaSelReselCellInfo written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(hsdpaCapable, HsdpaCapable, 5780U);
  EXPECT_NUMBER(edchCapable, EdchCapable, 0U);
  EXPECT_NUMBER(duplexMode, DuplexMode, 1);
  EXPECT_NUMBERS(multiBandInfos, MultiBandInfos, multiBandInfo, MultiBandInfo, <std::uint32_t>{4, 20, 300});
  EXPECT_NUMBER(imsEmergencySupport, ImsEmergencySupport, 65536U);
  EXPECT_NUMBER(cellBarred, CellBarred, 127U);
  EXPECT_NUMBER(fachMeasOccInfoPresent, FachMeasOccInfoPresent, 128U);
  EXPECT_NUMBER(sRxlev, SRxlev, std::numeric_limits<std::int32_t>::min());
  EXPECT_NUMBER(sQual, SQual, -1);
  EXPECT_NUMBER(sIntrasearch, SIntrasearch, -95);
  EXPECT_NUMBER(sIntersearch, SIntersearch, 12);
  EXPECT_NUMBER(sSearchRat, SSearchRat, -640);
  EXPECT_NUMBER(sCellPrio, SCellPrio, 16384U);
  EXPECT_MESSAGES(eutraPrioInfos, EutraPrioInfos, eutraPrioInfo, EutraPrioInfo,
                  readAll<EutraFreqInfo>({"08 b9 01 10 ff ff ff ff 0f", "10 07"}));
  EXPECT_MESSAGES(utraPrioInfos, UtraPrioInfos, utraPrioInfo, UtraPrioInfo,
                  readAll<UtraFreqInfo>({"08 ac 02 10 96 0a", "10 ad a0 01"}));
  EXPECT_MESSAGES(gsmPrioInfos, GsmPrioInfos, gsmPrioInfo, GsmPrioInfo,
                  readAll<GsmFreqInfo>({"08 94 2d 10 00", "10 80 80 04"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(EutraFreqInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 7f 10 80 01";
  const auto read = readFrom<EutraFreqInfo>(encoded);
  EXPECT_EQ(textOf(*read), "[earfcn: 127, prio: 128]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  EutraFreqInfo written;
  EXPECT_NUMBER(earfcn, Earfcn, 127U);
  EXPECT_NUMBER(prio, Prio, 128U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(UtraFreqInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 80 80 01 10 b9 01";
  const auto read = readFrom<UtraFreqInfo>(encoded);
  EXPECT_EQ(textOf(*read), "[uarfcn: 16384, prio: 185]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  UtraFreqInfo written;
  EXPECT_NUMBER(uarfcn, Uarfcn, 16384U);
  EXPECT_NUMBER(prio, Prio, 185U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(GsmFreqInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 ff ff ff ff 0f 10 07";
  const auto read = readFrom<GsmFreqInfo>(encoded);
  EXPECT_EQ(textOf(*read), "[arfcn: 4294967295, prio: 7]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  GsmFreqInfo written;
  EXPECT_NUMBER(arfcn, Arfcn, 4294967295U);
  EXPECT_NUMBER(prio, Prio, 7U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularWcdmaScellMeasurement, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 10 01 1a 0f 08 fe ff ff ff 0f 10 96 0a 18 ad a0 01 20 7e 1a 02 20 7f";
  const auto read = readFrom<KCellularWcdmaScellMeasurement>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, connected_mode: 1, rx_info: [[rssi: 2147483647, rsrp_range: 1302, "
            "rsrq_range: 20525, snr: 63], [snr: -64]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularWcdmaScellMeasurement written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_NUMBER(connectedMode, ConnectedMode, true);
  EXPECT_MESSAGES(rxInfos, RxInfos, rxInfo, RxInfo,
                  readAll<RxInfo>({"08 fe ff ff ff 0f 10 96 0a 18 ad a0 01 20 7e", "20 7f"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularWcdmaTxPower, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 81 d0 95 ff bc 31 12 0a 08 ff ff ff ff 0f 10 01 18 00 12 04 18 80 80 04";
  const auto read = readFrom<KCellularWcdmaTxPower>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, tx_power_info: [[pucch_tx_power: -2147483648, pusch_tx_power: -1, "
            "subframe_index: 0], [subframe_index: 65536]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularWcdmaTxPower written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_MESSAGES(txPowerInfos, TxPowerInfos, txPowerInfo, TxPowerInfo,
                  readAll<TxPowerInfo>({"08 ff ff ff ff 0f 10 01 18 00", "18 80 80 04"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularWcdmaNbrCellMeas, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 12 13 08 80 01 10 80 80 01 18 b9 01 20 ff ff ff ff 0f 28 bd 01 12 02 28 18 1a 08 08 "
      "07 10 ac 02 18 96 0a 1a 04 18 ad a0 01 22 12 08 94 2d 10 00 18 80 80 04 20 ff 09 28 fe ff ff ff 0f 22 02 "
      "28 7e";
  const auto read = readFrom<KCellularWcdmaNbrCellMeas>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, meas_utra_result: [[uarfcn: 128, band: 16384, psc: 185, ecno: "
            "4294967295, rscp: -95], [rscp: 12]], meas_gsm_result: [[arfcn: 7, bsic: 300, rxlev: 1302], [rxlev: "
            "20525]], meas_lte_result: [[earfcn: 5780, phy_cell_id: 0, eutra_band: 65536, rsrp: -640, rsrq: "
            "2147483647], [rsrq: 63]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularWcdmaNbrCellMeas written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_MESSAGES(measUtraResults, MeasUtraResults, measUtraResult, MeasUtraResult,
                  readAll<UtraCellMeasResult>({"08 80 01 10 80 80 01 18 b9 01 20 ff ff ff ff 0f 28 bd 01", "28 18"}));
  EXPECT_MESSAGES(measGsmResults, MeasGsmResults, measGsmResult, MeasGsmResult,
                  readAll<GsmCellMeasResult>({"08 07 10 ac 02 18 96 0a", "18 ad a0 01"}));
  EXPECT_MESSAGES(measLteResults, MeasLteResults, measLteResult, MeasLteResult,
                  readAll<LteCellMeasResult>({"08 94 2d 10 00 18 80 80 04 20 ff 09 28 fe ff ff ff 0f", "28 7e"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(UtraCellMeasResult, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 7f 10 80 01 18 80 80 01 20 b9 01 28 7f";
  const auto read = readFrom<UtraCellMeasResult>(encoded);
  EXPECT_EQ(textOf(*read), "[uarfcn: 127, band: 128, psc: 16384, ecno: 185, rscp: -64]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  UtraCellMeasResult written;
  EXPECT_NUMBER(uarfcn, Uarfcn, 127U);
  EXPECT_NUMBER(band, Band, 128U);
  EXPECT_NUMBER(psc, Psc, 16384U);
  EXPECT_NUMBER(ecno, Ecno, 185U);
  EXPECT_NUMBER(rscp, Rscp, -64);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(GsmCellMeasResult, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 ff ff ff ff 0f 10 07 18 ac 02";
  const auto read = readFrom<GsmCellMeasResult>(encoded);
  EXPECT_EQ(textOf(*read), "[arfcn: 4294967295, bsic: 7, rxlev: 300]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  GsmCellMeasResult written;
  EXPECT_NUMBER(arfcn, Arfcn, 4294967295U);
  EXPECT_NUMBER(bsic, Bsic, 7U);
  EXPECT_NUMBER(rxlev, Rxlev, 300U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(LteCellMeasResult, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 96 0a 10 ad a0 01 18 94 2d 20 ff ff ff ff 0f 28 01";
  const auto read = readFrom<LteCellMeasResult>(encoded);
  EXPECT_EQ(textOf(*read), "[earfcn: 1302, phy_cell_id: 20525, eutra_band: 5780, rsrp: -2147483648, rsrq: -1]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  LteCellMeasResult written;
  EXPECT_NUMBER(earfcn, Earfcn, 1302U);
  EXPECT_NUMBER(phyCellId, PhyCellId, 20525U);
  EXPECT_NUMBER(eutraBand, EutraBand, 5780U);
  EXPECT_NUMBER(rsrp, Rsrp, std::numeric_limits<std::int32_t>::min());
  EXPECT_NUMBER(rsrq, Rsrq, -1);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope
