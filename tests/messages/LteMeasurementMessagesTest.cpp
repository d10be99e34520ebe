// Every LTE measurement message against bytes of another encoder: each field read, shown, written, taken away.
#include <limits>

#include <gtest/gtest.h>

#include "MessageTesting.h"
#include "messages/lte/EgwErrcNbrEutraMeas.h"
#include "messages/lte/EgwErrcNbrGeranMeas.h"
#include "messages/lte/EgwErrcNbrUtraMeas.h"
#include "messages/lte/KCellularLteCarrierAggregationStatus.h"
#include "messages/lte/KCellularLteComponentCarrierInfo.h"
#include "messages/lte/KCellularLteNbrEutraCellMeas.h"
#include "messages/lte/KCellularLteNbrInterRatCellMeas.h"
#include "messages/lte/KCellularLteRsrpRsrqSinr.h"
#include "messages/lte/KCellularLteServingCellMeasurement.h"
#include "messages/lte/KCellularLteTxPower.h"
#include "messages/lte/RsrpRsrqSinr.h"
#include "messages/lte/RxInfo.h"
#include "messages/lte/SecondaryComponentCarrier.h"
#include "messages/lte/TxPowerInfo.h"

namespace vespscope {
namespace {

TEST(KCellularLteServingCellMeasurement, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 81 d0 95 ff bc 31 10 01 1a 0d 08 7f 10 7f 18 80 01 20 ff ff ff ff 0f 1a 02 20 01";
  const auto read = readFrom<KCellularLteServingCellMeasurement>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, is_connected_mode: 1, rx_info: [[rssi: -64, rsrp_range: 127, rsrq_range: "
            "128, snr: -2147483648], [snr: -1]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteServingCellMeasurement written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_NUMBER(isConnectedMode, IsConnectedMode, true);
  EXPECT_MESSAGES(rxInfos, RxInfos, rxInfo, RxInfo,
                  readAll<RxInfo>({"08 7f 10 7f 18 80 01 20 ff ff ff ff 0f", "20 01"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(RxInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 bd 01 10 80 80 01 18 b9 01 20 18";
  const auto read = readFrom<RxInfo>(encoded);
  EXPECT_EQ(textOf(*read), "[rssi: -95, rsrp_range: 16384, rsrq_range: 185, snr: 12]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  RxInfo written;
  EXPECT_NUMBER(rssi, Rssi, -95);
  EXPECT_NUMBER(rsrpRange, RsrpRange, 16384U);
  EXPECT_NUMBER(rsrqRange, RsrqRange, 185U);
  EXPECT_NUMBER(snr, Snr, 12);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularLteTxPower, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 b5 88 86 fe ea 31 12 0b 08 ff 09 10 fe ff ff ff 0f 18 07 12 03 18 ac 02";
  const auto read = readFrom<KCellularLteTxPower>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, tx_power_info: [[pucch_tx_power: -640, pusch_tx_power: 2147483647, "
            "subframe_index: 7], [subframe_index: 300]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteTxPower written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_MESSAGES(txPowerInfos, TxPowerInfos, txPowerInfo, TxPowerInfo,
                  readAll<TxPowerInfo>({"08 ff 09 10 fe ff ff ff 0f 18 07", "18 ac 02"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(TxPowerInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 7e 10 7f 18 96 0a";
  const auto read = readFrom<TxPowerInfo>(encoded);
  EXPECT_EQ(textOf(*read), "[pucch_tx_power: 63, pusch_tx_power: -64, subframe_index: 1302]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  TxPowerInfo written;
  EXPECT_NUMBER(pucchTxPower, PucchTxPower, 63);
  EXPECT_NUMBER(puschTxPower, PuschTxPower, -64);
  EXPECT_NUMBER(subframeIndex, SubframeIndex, 1302U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularLteRsrpRsrqSinr, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 1a 0c 76 6f 6c 74 65 2d 63 61 6c 6c 2d 37 30 94 2d 38 00 40 80 80 04 50 7f 58 80 01 "
      "72 0c 08 80 80 01 38 ff ff ff ff 0f 58 01 7a 08 08 b9 01 38 bd 01 58 18 7a 03 58 ff 09";
  const auto read = readFrom<KCellularLteRsrpRsrqSinr>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, call_id: volte-call-7, last_x_seconds: 5780, last_y_samples: 0, "
            "sample_period_ms: 65536, duration_ms: 127, num_samples: 128, avg_values: [phy_cell_id: 16384, "
            "rsrq0: -2147483648, sinr1: -1], inst_values: [[phy_cell_id: 185, rsrq0: -95, sinr1: 12], [sinr1: "
            "-640]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteRsrpRsrqSinr written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_CONTENT(callId, CallId, std::string("volte-call-7"));
  EXPECT_NUMBER(lastXSeconds, LastXSeconds, 5780U);
  EXPECT_NUMBER(lastYSamples, LastYSamples, 0U);
  EXPECT_NUMBER(samplePeriodMs, SamplePeriodMs, 65536U);
  EXPECT_NUMBER(durationMs, DurationMs, 127U);
  EXPECT_NUMBER(numSamples, NumSamples, 128U);
  EXPECT_MESSAGE(avgValues, AvgValues, readFrom<RsrpRsrqSinr>("08 80 80 01 38 ff ff ff ff 0f 58 01"));
  EXPECT_MESSAGES(instValues, InstValues, instValues, InstValues,
                  readAll<RsrpRsrqSinr>({"08 b9 01 38 bd 01 58 18", "58 ff 09"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(RsrpRsrqSinr, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 ff ff ff ff 0f 20 fe ff ff ff 0f 28 7e 38 7f 40 ff ff ff ff 0f 50 01 58 bd 01";
  const auto read = readFrom<RsrpRsrqSinr>(encoded);
  EXPECT_EQ(textOf(*read),
            "[phy_cell_id: 4294967295, rsrp0: 2147483647, rsrp1: 63, rsrq0: -64, rsrq1: -2147483648, sinr0: -1, "
            "sinr1: -95]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  RsrpRsrqSinr written;
  EXPECT_NUMBER(phyCellId, PhyCellId, 4294967295U);
  EXPECT_NUMBER(rsrp0, Rsrp0, 2147483647);
  EXPECT_NUMBER(rsrp1, Rsrp1, 63);
  EXPECT_NUMBER(rsrq0, Rsrq0, -64);
  EXPECT_NUMBER(rsrq1, Rsrq1, std::numeric_limits<std::int32_t>::min());
  EXPECT_NUMBER(sinr0, Sinr0, -1);
  EXPECT_NUMBER(sinr1, Sinr1, -95);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularLteComponentCarrierInfo, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 81 d0 95 ff bc 31 10 ac 02 18 96 0a 20 ad a0 01 28 94 2d 30 00 38 80 80 04";
  const auto read = readFrom<KCellularLteComponentCarrierInfo>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, pcc_earfcn: 300, scc0_earfcn: 1302, scc1_earfcn: 20525, pcc_bandwidth: "
            "5780, scc0_bandwidth: 0, scc1_bandwidth: 65536]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteComponentCarrierInfo written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_NUMBER(pccEarfcn, PccEarfcn, 300U);
  EXPECT_NUMBER(scc0Earfcn, Scc0Earfcn, 1302U);
  EXPECT_NUMBER(scc1Earfcn, Scc1Earfcn, 20525U);
  EXPECT_NUMBER(pccBandwidth, PccBandwidth, 5780U);
  EXPECT_NUMBER(scc0Bandwidth, Scc0Bandwidth, 0U);
  EXPECT_NUMBER(scc1Bandwidth, Scc1Bandwidth, 65536U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularLteCarrierAggregationStatus, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 b5 88 86 fe ea 31 12 09 08 80 01 40 80 80 01 70 18 12 03 70 ff 09";
  const auto read = readFrom<KCellularLteCarrierAggregationStatus>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, scc_list: [[index: 128, ul_earfcn: 16384, rssi: 12], [rssi: -640]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteCarrierAggregationStatus written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_MESSAGES(sccLists, SccLists, sccList, SccList,
                  readAll<SecondaryComponentCarrier>({"08 80 01 40 80 80 01 70 18", "70 ff 09"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(SecondaryComponentCarrier, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b9 01 10 03 18 ff ff ff ff 0f 20 07 28 ac 02 30 96 0a 38 01 40 ad a0 01 48 94 2d 50 00 58 fe ff ff ff "
      "0f 60 7e 68 7f 70 ff ff ff ff 0f";
  const auto read = readFrom<SecondaryComponentCarrier>(encoded);
  EXPECT_EQ(textOf(*read),
            "[index: 185, state: (unknown: 3), pci: 4294967295, dl_earfcn: 7, dl_rf_band: 300, dl_bandwidth: "
            "1302, has_uplink: 1, ul_earfcn: 20525, ul_rf_band: 5780, ul_bandwidth: 0, rsrp: 2147483647, rsrq: "
            "63, snr: -64, rssi: -2147483648]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  SecondaryComponentCarrier written;
  EXPECT_NUMBER(index, Index, 185U);
  EXPECT_NUMBER(state, State, 3);
  EXPECT_NUMBER(pci, Pci, 4294967295U);
  EXPECT_NUMBER(dlEarfcn, DlEarfcn, 7U);
  EXPECT_NUMBER(dlRfBand, DlRfBand, 300U);
  EXPECT_NUMBER(dlBandwidth, DlBandwidth, 1302U);
  EXPECT_NUMBER(hasUplink, HasUplink, true);
  EXPECT_NUMBER(ulEarfcn, UlEarfcn, 20525U);
  EXPECT_NUMBER(ulRfBand, UlRfBand, 5780U);
  EXPECT_NUMBER(ulBandwidth, UlBandwidth, 0U);
  EXPECT_NUMBER(rsrp, Rsrp, 2147483647);
  EXPECT_NUMBER(rsrq, Rsrq, 63);
  EXPECT_NUMBER(snr, Snr, -64);
  EXPECT_NUMBER(rssi, Rssi, std::numeric_limits<std::int32_t>::min());
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularLteNbrEutraCellMeas, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 81 d0 95 ff bc 31 12 0e 08 7f 10 80 01 18 80 80 01 20 01 28 bd 01 12 02 28 18";
  const auto read = readFrom<KCellularLteNbrEutraCellMeas>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1700000000001, meas_nbr_eutra: [[nbr_earfcn: 127, nbr_phys_cell_id: 128, freq_band_ind: "
            "16384, nbr_rsrp: -1, nbr_rsrq: -95], [nbr_rsrq: 12]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteNbrEutraCellMeas written;
  EXPECT_NUMBER(timestamp, Timestamp, 1700000000001U);
  EXPECT_MESSAGES(measNbrEutras, MeasNbrEutras, measNbrEutra, MeasNbrEutra,
                  readAll<EgwErrcNbrEutraMeas>({"08 7f 10 80 01 18 80 80 01 20 01 28 bd 01", "28 18"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(EgwErrcNbrEutraMeas, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 b9 01 10 ff ff ff ff 0f 18 07 20 ff 09 28 fe ff ff ff 0f";
  const auto read = readFrom<EgwErrcNbrEutraMeas>(encoded);
  EXPECT_EQ(textOf(*read),
            "[nbr_earfcn: 185, nbr_phys_cell_id: 4294967295, freq_band_ind: 7, nbr_rsrp: -640, nbr_rsrq: "
            "2147483647]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  EgwErrcNbrEutraMeas written;
  EXPECT_NUMBER(nbrEarfcn, NbrEarfcn, 185U);
  EXPECT_NUMBER(nbrPhysCellId, NbrPhysCellId, 4294967295U);
  EXPECT_NUMBER(freqBandInd, FreqBandInd, 7U);
  EXPECT_NUMBER(nbrRsrp, NbrRsrp, -640);
  EXPECT_NUMBER(nbrRsrq, NbrRsrq, 2147483647);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(KCellularLteNbrInterRatCellMeas, ReadsShowsAndWritesEveryField) {
  const char* const encoded =
      "08 b5 88 86 fe ea 31 12 0c 08 96 0a 10 ad a0 01 18 7e 20 94 2d 12 02 20 00 1a 09 08 80 80 04 10 7f 18 80 "
      "01 1a 04 18 80 80 01";
  const auto read = readFrom<KCellularLteNbrInterRatCellMeas>(encoded);
  EXPECT_EQ(textOf(*read),
            "[timestamp: 1712345678901, meas_nbr_utra: [[uarfcn: 1302, psc: 20525, rscp: 63, ecno: 5780], [ecno: "
            "0]], meas_nbr_geran: [[arfcn: 65536, bsic: 127, rxlev: 128], [rxlev: 16384]]]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  KCellularLteNbrInterRatCellMeas written;
  EXPECT_NUMBER(timestamp, Timestamp, 1712345678901U);
  EXPECT_MESSAGES(measNbrUtras, MeasNbrUtras, measNbrUtra, MeasNbrUtra,
                  readAll<EgwErrcNbrUtraMeas>({"08 96 0a 10 ad a0 01 18 7e 20 94 2d", "20 00"}));
  EXPECT_MESSAGES(measNbrGerans, MeasNbrGerans, measNbrGeran, MeasNbrGeran,
                  readAll<EgwErrcNbrGeranMeas>({"08 80 80 04 10 7f 18 80 01", "18 80 80 01"}));
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(EgwErrcNbrUtraMeas, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 b9 01 10 ff ff ff ff 0f 18 7f 20 07";
  const auto read = readFrom<EgwErrcNbrUtraMeas>(encoded);
  EXPECT_EQ(textOf(*read), "[uarfcn: 185, psc: 4294967295, rscp: -64, ecno: 7]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  EgwErrcNbrUtraMeas written;
  EXPECT_NUMBER(uarfcn, Uarfcn, 185U);
  EXPECT_NUMBER(psc, Psc, 4294967295U);
  EXPECT_NUMBER(rscp, Rscp, -64);
  EXPECT_NUMBER(ecno, Ecno, 7U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

TEST(EgwErrcNbrGeranMeas, ReadsShowsAndWritesEveryField) {
  const char* const encoded = "08 ac 02 10 96 0a 18 ad a0 01";
  const auto read = readFrom<EgwErrcNbrGeranMeas>(encoded);
  EXPECT_EQ(textOf(*read), "[arfcn: 300, bsic: 1302, rxlev: 20525]");
  EXPECT_EQ(read->encoded(), hex(encoded));

  EgwErrcNbrGeranMeas written;
  EXPECT_NUMBER(arfcn, Arfcn, 300U);
  EXPECT_NUMBER(bsic, Bsic, 1302U);
  EXPECT_NUMBER(rxlev, Rxlev, 20525U);
  EXPECT_EQ(written.encoded(), hex(encoded));
  EXPECT_TRUE(read->encoded().empty());
}

}  // namespace
}  // namespace vespscope
