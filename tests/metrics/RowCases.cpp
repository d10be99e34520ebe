#include "RowCases.h"

#include <sstream>

namespace vespscope::test {
namespace {

template <auto holder, auto part>
std::string held(const MetricValidator& validator) {
  return textOf(validator.*holder.*part);
}

}  // namespace

const std::vector<RowCase>& rowCases() {
  static const std::vector<RowCase> cases = {
      {"KCellularSimCardFiles",
       3932179,
       "0880d095ffbc3112080887de0112020809120308e25f",
       "Received SIM Card File Info is",
       "ef_list: [[ef_id: 28423, content: <08 09>], [ef_id: 12258]]",
       {},
       &MetricValidator::mySIMFileInfoDict,
       "ef_list: [[ef_id: 28423, content: <08 09>], [ef_id: 12258]]",
       {{"myCommon.simContents", held<&MetricValidator::myCommon, &Common::simContents>,
         "[ef_id: 28423, content: <08 09>, timestamp: @][ef_id: 12258, timestamp: @]"}}},
      {"KCellularGsmScellInfo",
       3943948,
       "0880d095ffbc3120b602289a03300738634003488001502a58016803",
       "Received GSM Serving Cell Info",
       "mcc: 310, mnc: 410, lac: 7, cell_id: 99, gsm_band: SYS_BAND_BC3, arfcn: 128, bsic: 42, state: DEDICATED_STATE, "
       "num_mnc_digits: 3",
       {},
       &MetricValidator::myGSMScellInfoDict,
       "mcc: 310, mnc: 410, lac: 7, cell_id: 99, gsm_band: SYS_BAND_BC3, arfcn: 128, bsic: 42, state: DEDICATED_STATE, "
       "num_mnc_digits: 3",
       {}},
      {"KCellularWcdmaCellInfo",
       3944460,
       "0880d095ffbc3120b602289a03300838ffffff7f400148c25250ff0368037001",
       "Received UMTS Serving Cell Info is",
       "mcc: 310, mnc: 410, lac: 8, cell_id: 268435455, wcdma_band: SYS_BAND_BC1, dl_uarfcn: 10562, psc: 511, "
       "num_mnc_digits: 3, hspa: SYS_HS_IND_HSDPA_SUPP_CELL",
       {},
       &MetricValidator::myUMTSCellInfoDict,
       "mcc: 310, mnc: 410, lac: 8, cell_id: 268435455, wcdma_band: SYS_BAND_BC1, dl_uarfcn: 10562, psc: 511, "
       "num_mnc_digits: 3, hspa: SYS_HS_IND_HSDPA_SUPP_CELL",
       {}},
      {"KCellularLteScellInfo",
       3948738,
       "0880d095ffbc3110b90118942d20e4b9012864300538014011",
       "Current Serving Cell Info is",
       "phy_cell_id: 185, dl_freq: 5780, ul_freq: 23780, dl_bw: 100, ul_bw: 5, cell_id: 1, freq_band_ind: 17",
       {},
       &MetricValidator::myLTESCellInfoDict,
       "phy_cell_id: 185, dl_freq: 5780, ul_freq: 23780, dl_bw: 50, ul_bw: 2, cell_id: 1, freq_band_ind: 17",
       {}},
      {"KCellularLteRrcState",
       3952132,
       "0880d095ffbc311003180120a01f2804",
       "Current RRC state is",
       "state: KLTE_RRC_STATE_CONNECTED, prev_state: KLTE_RRC_STATE_IDLE, prev_state_dur_ms: 4000, cause: "
       "KLTE_RRC_CAUSE_EST_MO_DATA",
       {},
       &MetricValidator::myLTERRCStateDict,
       "state: KLTE_RRC_STATE_CONNECTED, prev_state: KLTE_RRC_STATE_IDLE, prev_state_dur_ms: 4000, cause: "
       "KLTE_RRC_CAUSE_EST_MO_DATA",
       {}},
      {"KCellularLteCdrxConfig",
       3952152,
       "0880d095ffbc31180a38c0026001",
       "Current CDRX Config is",
       "on_duration_ms: 10, long_drx_cycle_ms: 320, rrc_state: KLTE_RRC_STATE_IDLE",
       {},
       &MetricValidator::myLTECDRXConfigDict,
       "on_duration_ms: 10, long_drx_cycle_ms: 320, rrc_state: KLTE_RRC_STATE_IDLE",
       {}},
      {"KCellularLteRsrpRsrqSinr",
       3952490,
       "0880d095ffbc311a026331720520b30150287a0c08b90120b5013815503258057a020807",
       "Received RSRP RSRQ SINR is :",
       "call_id: c1, avg_values: [rsrp0: -90, sinr0: 20], inst_values: [[phy_cell_id: 185, rsrp0: -91, rsrq0: -11, "
       "sinr0: 25, sinr1: -3], [phy_cell_id: 7]]",
       {},
       &MetricValidator::myLTERsrpRsrqSinrDict,
       "call_id: c1, avg_values: [rsrp0: -90, sinr0: 20], inst_values: [[phy_cell_id: 185, rsrp0: -91, rsrq0: -11, "
       "sinr0: 25, sinr1: -3], [phy_cell_id: 7]]",
       {{"myLTE.RsrpRsrqSinr", held<&MetricValidator::myLTE, &LTE::RsrpRsrqSinr>,
         "[phy_cell_id: 185, rsrp0: -91, rsrq0: -11, sinr0: 12.5, sinr1: -1.5, timestamp: @][phy_cell_id: 7, "
         "timestamp: @]"}}},
      {"KCellularGsmIdleConfig",
       3985409,
       "0880d095ffbc31108001800101980105e00101900200",
       "Received GSM Idle Config Info is",
       "arfcn_bcch: 128, cbq: 1, attach_allowed: 1, si_2_ter_needed: 0",
       {},
       &MetricValidator::myGSMIdleConfigInfoDict,
       "arfcn_bcch: 128, cbq: 1, attach_allowed: 1, si_2_ter_needed: 0",
       {}},
      {"KCellularGsmIdleScellMeasurement",
       3985410,
       "0880d095ffbc31108001289501",
       "Received GSM Idle Serving Cell Meas Info is",
       "scell_arfcn: 128, idle_rxlev_dBm: -75",
       {},
       &MetricValidator::myGSMIdleScellMeasDict,
       "scell_arfcn: 128, idle_rxlev_dBm: -75",
       {}},
      {"KCellularGsmCsRfMeasurement",
       3985411,
       "0880d095ffbc311080012a0201423028",
       "Received GSM Connected Serving Cell Meas Info is",
       "scell_arfcn: 128, cs_tx_pwr: [-1, 33], cs_rxlev_sub: 40",
       {},
       &MetricValidator::myGSMConnRfMeasDict,
       "scell_arfcn: 128, cs_tx_pwr: [-1, 33], cs_rxlev_sub: 40",
       {}},
      {"KCellularGsmGrrEventMeasCr",
       3985417,
       "0880d095ffbc311204300c383f1a061009200028312207186120942d2822",
       "Received GSM Nbr Cell Meas Info is",
       "gsm_ncell_meas: [[arfcn: 12, rxlev: 63]], umts_ncell_meas: [[cpich_sc: 9, cpich_rscp: 0, cpich_ecn0: 49]], "
       "lte_ncell_meas: [[rsrp: 97, earfcn: 5780, rsrq: 34]]",
       {},
       &MetricValidator::myGSMNbrMeasDict,
       "gsm_ncell_meas: [[arfcn: 12, rxlev: 63]], umts_ncell_meas: [[cpich_sc: 9, cpich_rscp: 0, cpich_ecn0: 49]], "
       "lte_ncell_meas: [[rsrp: 97, earfcn: 5780, rsrq: 34]]",
       {{"myGSM.geraNbrMeas", held<&MetricValidator::myGSM, &GSM::geraNbrMeas>,
         "[arfcn: 12, rxlev: -47, timestamp: @]"},
        {"myGSM.utraNbrMeas", held<&MetricValidator::myGSM, &GSM::utraNbrMeas>,
         "[cpich_sc: 9, cpich_rscp: -116, cpich_ecn0: 49, timestamp: @]"},
        {"myGSM.eUtraNbrMeas", held<&MetricValidator::myGSM, &GSM::eUtraNbrMeas>,
         "[rsrp: -43, earfcn: 5780, rsrq: -2.5, timestamp: @]"}}},
      {"KCellularGsmGprsConfig",
       3985420,
       "0880d095ffbc311001180320005800",
       "Received GSM GPRS Config Info is",
       "gprs_sup: 1, rac: 3, sp_pg_cy: 0, cell_bar_access_2: 0",
       {},
       &MetricValidator::myGSMGPRSConfigDict,
       "gprs_sup: 1, rac: 3, sp_pg_cy: 0, cell_bar_access_2: 0",
       {}},
      {"KCellularWcdmaScellMeasurement",
       3985666,
       "0880d095ffbc3110011a04087710031a022003",
       "Received UMTS Serving Cell Meas is",
       "connected_mode: 1, rx_info: [[rssi: -60, rsrp_range: 3], [snr: -2]]",
       {},
       &MetricValidator::myUMTSCellMeasDict,
       "connected_mode: 1, rx_info: [[rssi: -60, rsrp_range: 3], [snr: -2]]",
       {{"myUMTS.rXInfo", held<&MetricValidator::myUMTS, &UMTS::rXInfo>,
         "[rssi: -60, rsrp_range: 3, timestamp: @, connected_mode: 1][snr: -2, timestamp: @, connected_mode: 1]"}}},
      {"KCellularWcdmaTxPower",
       3985667,
       "0880d095ffbc31120408111801",
       "Received Tx Power is",
       "tx_power_info: [[pucch_tx_power: -9, subframe_index: 1]]",
       {},
       &MetricValidator::myUMTSTxPowerDict,
       "tx_power_info: [[pucch_tx_power: -9, subframe_index: 1]]",
       {{"myUMTS.TxPower", held<&MetricValidator::myUMTS, &UMTS::TxPower>,
         "[pucch_tx_power: -9, subframe_index: 1, timestamp: @]"}}},
      {"KCellularWcdmaSelReselCellInfo",
       3985668,
       "0880d095ffbc311001180020002a02020430013800400048185005580a6808b2010508942d1006",
       "Received UMTS Cell Resel Info is",
       "hsdpa_capable: 1, edch_capable: 0, duplex_mode: FDD, multi_band_info: [2, 4], ims_emergency_support: 1, "
       "cell_barred: 0, fach_meas_occ_info_present: 0, s_rxlev: 12, s_qual: -3, s_intrasearch: 5, s_search_rat: 4, "
       "eutra_prio_info: [[earfcn: 5780, prio: 6]]",
       {"[2, 4]"},
       &MetricValidator::myUMTSSelReselDict,
       "hsdpa_capable: 1, edch_capable: 0, duplex_mode: FDD, multi_band_info: [2, 4], ims_emergency_support: 1, "
       "cell_barred: 0, fach_meas_occ_info_present: 0, s_rxlev: 12, s_qual: -3, s_intrasearch: 5, s_search_rat: 4, "
       "eutra_prio_info: [[earfcn: 5780, prio: 6]]",
       {{"myUMTS.SelReselCellInfo", held<&MetricValidator::myUMTS, &UMTS::SelReselCellInfo>,
         "[ims_emergency_support: 1, hsdpa_capable: 1, edch_capable: 0, duplex_mode: FDD, cell_barred: 0, "
         "fach_meas_occ_info_present: 0, s_rxlev: 12, s_qual: -3, s_intrasearch: 5]"},
        {"myUMTS.eUtraNbrs", held<&MetricValidator::myUMTS, &UMTS::eUtraNbrs>,
         "[earfcn: 5780, prio: 6, timestamp: @]"}}},
      {"KCellularWcdmaNbrCellMeas",
       3985669,
       "0880d095ffbc3112061809200028001a04080c1800220708bc0520582828",
       "Received UMTS InterRat Meas Info is",
       "meas_utra_result: [[psc: 9, ecno: 0, rscp: 0]], meas_gsm_result: [[arfcn: 12, rxlev: 0]], meas_lte_result: "
       "[[earfcn: 700, rsrp: 44, rsrq: 20]]",
       {},
       &MetricValidator::myUMTSNbrMeasDict,
       "meas_utra_result: [[psc: 9, ecno: 0, rscp: 0]], meas_gsm_result: [[arfcn: 12, rxlev: 0]], meas_lte_result: "
       "[[earfcn: 700, rsrp: 44, rsrq: 20]]",
       {{"myUMTS.utraNbrMeas", held<&MetricValidator::myUMTS, &UMTS::utraNbrMeas>,
         "[psc: 9, ecno: -24.5, rscp: -116, timestamp: @]"},
        {"myUMTS.geraNbrMeas", held<&MetricValidator::myUMTS, &UMTS::geraNbrMeas>,
         "[arfcn: 12, rxlev: -110, timestamp: @]"},
        {"myUMTS.eUtraNbrMeas", held<&MetricValidator::myUMTS, &UMTS::eUtraNbrMeas>,
         "[earfcn: 700, rsrp: -96, rsrq: -9.5, timestamp: @]"}}},
      {"KCellularWcdmaRrcConnectionState",
       3985682,
       "0880d095ffbc31100518002002",
       "Received UMTS RRC Connection State is",
       "state: KWCDMA_RRC_CONN_STATE_CELL_PCH, establishment_cause: KRRC_EST_ORIG_CONV_CALL, release_cause: "
       "KRRC_REL_NO_CELL",
       {},
       &MetricValidator::myUMTSRRCStateDict,
       "state: KWCDMA_RRC_CONN_STATE_CELL_PCH, establishment_cause: KRRC_EST_ORIG_CONV_CALL, release_cause: "
       "KRRC_REL_NO_CELL",
       {}},
      {"KCellularWcdmaRrcConfiguration",
       3985683,
       "0880d095ffbc3110800518002001",
       "Received UMTS RRC Configuration is",
       "drx_cycle_length_ms: 640, is_mimo_configured: 0, is_dc_configured: 1",
       {},
       &MetricValidator::myUMTSRRCConfigDict,
       "drx_cycle_length_ms: 640, is_mimo_configured: 0, is_dc_configured: 1",
       {}},
      {"KCellularLteTxPower",
       3986178,
       "0880d095ffbc3112060811102e1804",
       "Received LTE Tx Power is",
       "tx_power_info: [[pucch_tx_power: -9, pusch_tx_power: 23, subframe_index: 4]]",
       {},
       &MetricValidator::myLTETxPowerDict,
       "tx_power_info: [[pucch_tx_power: -9, pusch_tx_power: 23, subframe_index: 4]]",
       {{"myLTE.TxPower", held<&MetricValidator::myLTE, &LTE::TxPower>,
         "[pucch_tx_power: -9, pusch_tx_power: 23, subframe_index: 4, timestamp: @]"}}},
      {"KCellularLteComponentCarrierInfo",
       3986187,
       "0880d095ffbc3110942d18bc052832",
       "Received Component Carrier info is",
       "pcc_earfcn: 5780, scc0_earfcn: 700, pcc_bandwidth: 50",
       {},
       &MetricValidator::myLTECompCarrDict,
       "pcc_earfcn: 5780, scc0_earfcn: 700, pcc_bandwidth: 50",
       {}},
      {"KCellularLteSelReselCellInfo",
       3986190,
       "0880d095ffbc311201111801587b900102980101a00105aa010708bc0530056000aa010508d00f3007",
       "Received LTE Cell Resel Info is",
       "multi_band_info: [17], ims_emergency_support: 1, QRxLevMin: -62, Thresh_serving_lowP: 2, "
       "priority_operating_freq: 5, nbr_eutra: [[earfcn: 700, dl_bw: 5, frame_type: FDD], [earfcn: 2000, dl_bw: 7]]",
       {"[17]"},
       &MetricValidator::myLTESelReselDict,
       "multi_band_info: [17], ims_emergency_support: 1, QRxLevMin: -62, Thresh_serving_lowP: 2, "
       "priority_operating_freq: 5, nbr_eutra: [[earfcn: 700, dl_bw: 5, frame_type: FDD], [earfcn: 2000, dl_bw: 7]]",
       {{"myLTE.SelReselCellInfo", held<&MetricValidator::myLTE, &LTE::SelReselCellInfo>,
         "[timestamp: @, ims_emergency_support: 1, QRxLevMin: -62, Thresh_serving_lowP: 2, priority_operating_freq: "
         "5]"},
        {"myLTE.EutraNbrs", held<&MetricValidator::myLTE, &LTE::EutraNbrs>,
         "[earfcn: 700, dl_bw: 20.0, frame_type: FDD, timestamp: @][earfcn: 2000, timestamp: @]"}}},
      {"KCellularLteNbrEutraCellMeas",
       3986191,
       "0880d095ffbc31120908942d100320502828",
       "Received LTE IRAT Meas is",
       "meas_nbr_eutra: [[nbr_earfcn: 5780, nbr_phys_cell_id: 3, nbr_rsrp: 40, nbr_rsrq: 20]]",
       {},
       &MetricValidator::myLTEIntraRatMeasDict,
       "meas_nbr_eutra: [[nbr_earfcn: 5780, nbr_phys_cell_id: 3, nbr_rsrp: 40, nbr_rsrq: 20]]",
       {{"myLTE.EutraNbrsMeas", held<&MetricValidator::myLTE, &LTE::EutraNbrsMeas>,
         "[nbr_earfcn: 5780, nbr_phys_cell_id: 3, nbr_rsrp: -100, nbr_rsrq: -9.5, timestamp: @]"}}},
      {"KCellularLteNbrInterRatCellMeas",
       3986192,
       "0880d095ffbc31120908c2521009180920141a06080c10031814",
       "Received LTE InterRat Meas Info is",
       "meas_nbr_utra: [[uarfcn: 10562, psc: 9, rscp: -5, ecno: 20]], meas_nbr_geran: [[arfcn: 12, bsic: 3, rxlev: "
       "20]]",
       {},
       &MetricValidator::myLTEInterRatMeasDict,
       "meas_nbr_utra: [[uarfcn: 10562, psc: 9, rscp: -5, ecno: 20]], meas_nbr_geran: [[arfcn: 12, bsic: 3, rxlev: "
       "20]]",
       {{"myLTE.UtraNbrsMeas", held<&MetricValidator::myLTE, &LTE::UtraNbrsMeas>,
         "[uarfcn: 10562, psc: 9, rscp: -121, ecno: -14.5, timestamp: @]"},
        {"myLTE.GeraNbrsMeas", held<&MetricValidator::myLTE, &LTE::GeraNbrsMeas>,
         "[arfcn: 12, bsic: 3, rxlev: -90, timestamp: @]"}}},
      {"KCellularLteCarrierAggregationStatus",
       3986195,
       "0880d095ffbc31121b0801100218b90120bc053003380058b38d0160b31068e01270ed60",
       "Received CA Status Dict is",
       "scc_list: [[index: 1, state: SCC_STATE_ACTIVATED, pci: 185, dl_earfcn: 700, dl_bandwidth: 3, has_uplink: 0, "
       "rsrp: -9050, rsrq: -1050, snr: 1200, rssi: -6199]]",
       {},
       &MetricValidator::myLTECAStatusDict,
       "scc_list: [[index: 1, state: SCC_STATE_ACTIVATED, pci: 185, dl_earfcn: 700, dl_bandwidth: 3, has_uplink: 0, "
       "rsrp: -9050, rsrq: -1050, snr: 1200, rssi: -6199]]",
       {{"myLTE.CAStatusList", held<&MetricValidator::myLTE, &LTE::CAStatusList>,
         "[index: 1, state: SCC_STATE_ACTIVATED, pci: 185, dl_earfcn: 700, dl_bandwidth: 10.0, has_uplink: 0, rsrp: "
         "-90, rsrq: -10.5, snr: 1200, rssi: -61, timestamp: @]"}}},
      {"KCellularMmCommonInfo",
       3986697,
       "0880d095ffbc31120201021a050a03130014",
       "Received MM Common Info Dict is :",
       "imsi: <01 02>, eplmn_list: [[encoded_plmn: <13 00 14>]]",
       {},
       &MetricValidator::myCellularMMCommonInfoDict,
       "imsi: <01 02>, eplmn_list: [[encoded_plmn: <13 00 14>]]",
       {}},
      {"KCellularMmContext",
       3986698,
       "0880d095ffbc31100018012202100728ffffffff0f",
       "Received MM Context Info is",
       "reg_status: KREG_STATUS_NORMAL_SERVICE, update_status: STATUS_UPDATED, lai: [lac: 7], tmsi: 4294967295",
       {},
       &MetricValidator::myMMContextDict,
       "reg_status: KREG_STATUS_NORMAL_SERVICE, update_status: STATUS_UPDATED, lai: [lac: 7], tmsi: 4294967295",
       {}},
      {"KCellularGmmContext",
       3986699,
       "0880d095ffbc3122090a031300141807200330a819",
       "Received GMM Context Info is",
       "rai: [encoded_plmn: <13 00 14>, lac: 7, rac: 3], t3312_dur_s: 3240",
       {},
       &MetricValidator::myGMMContextDict,
       "rai: [encoded_plmn: <13 00 14>, lac: 7, rac: 3], t3312_dur_s: 3240",
       {}},
      {"KCellularEmmContext",
       3986700,
       "0880d095ffbc3118012a070a0313001410092a02100a3206080110021803",
       "Received EMM Context is",
       "update_status: EPS_STATUS_NOT_UPDATED, tai_list: [[encoded_plmn: <13 00 14>, tac: 9], [tac: 10]], guti: "
       "[mmegi: 1, mmec: 2, m_tmsi: 3]",
       {},
       &MetricValidator::myLTEEMMContextDict,
       "update_status: EPS_STATUS_NOT_UPDATED, tai_list: [[encoded_plmn: <13 00 14>, tac: 9], [tac: 10]], guti: "
       "[mmegi: 1, mmec: 2, m_tmsi: 3]",
       {}},
      {"KCellularActivatedBearerContexts",
       3986701,
       "0880d095ffbc3110011a18080110051a08696e7465726e657420002a040a0000015001",
       "Received Bearer Context Info is",
       "bearer_context_count: 1, bearer_contexts: [[cid: 1, nsapi: 5, apn: internet, pdp_type: PDP_TYPE_IPv4, "
       "pdp_addr: <0a 00 00 01>, is_addr_irat_mobile: 1]]",
       {},
       &MetricValidator::myCellularActiveBearerDict,
       "bearer_context_count: 1, bearer_contexts: [[cid: 1, nsapi: 5, apn: internet, pdp_type: PDP_TYPE_IPv4, "
       "pdp_addr: <0a 00 00 01>, is_addr_irat_mobile: 1]]",
       {{"myCommon.activeBearer", held<&MetricValidator::myCommon, &Common::activeBearer>,
         "[cid: 1, nsapi: 5, apn: internet, pdp_type: PDP_TYPE_IPv4, pdp_addr: <0a 00 00 01>, is_addr_irat_mobile: 1, "
         "timestamp: @]"}}},
  };
  return cases;
}

std::string identifierLineOf(const RowCase& row) {
  std::ostringstream line;
  line << "Metric ID in Hex = " << std::uppercase << std::hex << row.identifier;
  return line.str();
}

std::vector<std::string> linesOf(const RowCase& row) {
  std::vector<std::string> lines = {identifierLineOf(row),
                                    std::string(row.literal) + " [timestamp: " + reportTime + ", " + row.report + "]"};
  lines.insert(lines.end(), row.furtherLines.begin(), row.furtherLines.end());
  return lines;
}

Bytes bytesOf(std::string_view hexadecimal) {
  Bytes bytes;
  for (std::size_t index = 0; index + 1 < hexadecimal.size(); index += 2) {
    bytes.push_back(static_cast<std::uint8_t>(std::stoul(std::string(hexadecimal.substr(index, 2)), nullptr, 16)));
  }
  return bytes;
}

std::string withTime(std::string text) {
  for (std::size_t at = text.find('@'); at != std::string::npos; at = text.find('@', at + reportTime.size())) {
    text.replace(at, 1, reportTime);
  }
  return text;
}

}  // namespace vespscope::test
