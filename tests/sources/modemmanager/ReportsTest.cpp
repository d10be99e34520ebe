// A modem's state as metric events, decoded again.
#include <map>
#include <optional>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "DecodedEvents.h"
#include "messages/WireReader.h"
#include "sources/modemmanager/Reports.h"

namespace vespscope::test {
namespace {

using namespace sources::modemmanager;

constexpr std::chrono::nanoseconds moment = std::chrono::milliseconds(1'700'000'000'123);

// The events of one update, by their metrics' names.
using Told = std::map<std::string, std::string>;

Told told(const std::vector<MetricEvent>& events) {
  Told texts;
  for (const MetricEvent& event : events) {
    EXPECT_EQ(event.time, moment);
    EXPECT_EQ(event.profileID, 0);
    const auto [name, text] = decodedEvent(event);
    EXPECT_TRUE(texts.emplace(name, text).second) << name << " comes twice";
  }
  return texts;
}

ModemState lteHome() {
  ModemState state;
  state.technology = Technology::lte;
  state.registration = Registration::home;
  state.network = radio::Plmn::fromText("310260");
  state.tac = 0x1A2B;
  state.cellId = 0x1C3D4E5;
  return state;
}

ModemState umtsHome() {
  ModemState state;
  state.technology = Technology::umts;
  state.registration = Registration::roaming;
  state.packetAttached = true;
  state.network = radio::Plmn::fromText("00101");
  state.lac = 0x0B0C;
  state.cellId = 0xABCDEF;
  return state;
}

Cell cell(Technology technology, std::uint32_t channel, std::uint32_t code, double power, double quality) {
  Cell made;
  made.technology = technology;
  made.channel = channel;
  made.code = code;
  made.power = power;
  made.quality = quality;
  return made;
}

Cell gsmCell(std::uint32_t channel, std::uint32_t code, std::uint32_t level) {
  Cell made;
  made.technology = Technology::gsm;
  made.channel = channel;
  made.code = code;
  made.levelCode = level;
  return made;
}

TEST(Reports, AreNoneForAModemThatReportsNothing) { EXPECT_EQ(told(Reports().update({}, moment)), Told{}); }

TEST(Reports, CoverLteRegistrationAndTheServingCell) {
  Reports reports;
  EXPECT_EQ(told(reports.update(lteHome(), moment)),
            (Told{{"EMM", "[reg_status: KREG_STATUS_NORMAL_SERVICE]"},
                  {"LTE cell",
                   "[cell_id: 29611237, tracking_area_code: 6699, num_mnc_digits: 3, sel_plmn_mcc: 310, "
                   "sel_plmn_mnc: 260]"}}));
  EXPECT_EQ(told(reports.update(lteHome(), moment)), Told{}) << "nothing new";
}

TEST(Reports, NameEachRegistrationState) {
  const std::map<Registration, std::string> names = {
      {Registration::idle, "KREG_STATUS_AT_NOT_REGISTERED"},
      {Registration::home, "KREG_STATUS_NORMAL_SERVICE"},
      {Registration::searching, "KREG_STATUS_REGISTRATION_IN_PROGRESS"},
      {Registration::denied, "KREG_STATUS_REGISTRATION_FAILURE"},
      {Registration::roaming, "KREG_STATUS_NORMAL_SERVICE"},
      {Registration::homeSmsOnly, "KREG_STATUS_REGISTERED_SMS_ONLY"},
      {Registration::roamingSmsOnly, "KREG_STATUS_REGISTERED_SMS_ONLY"},
      {Registration::emergencyOnly, "KREG_STATUS_EMERGENCY_SERVICE"},
      {Registration::homeCsfbNotPreferred, "KREG_STATUS_NORMAL_SERVICE"},
      {Registration::roamingCsfbNotPreferred, "KREG_STATUS_NORMAL_SERVICE"},
  };
  for (const auto& [registration, name] : names) {
    ModemState state;
    state.technology = Technology::lte;
    state.registration = registration;
    EXPECT_EQ(told(Reports().update(state, moment)), (Told{{"EMM", "[reg_status: " + name + "]"}}));
  }
}

TEST(Reports, CoverEachSupportedTechnologyOfAModemRegisteredNowhere) {
  ModemState state;
  state.registration = Registration::searching;
  EXPECT_EQ(told(Reports().update(state, moment)), Told{});
  state.mayUseLte = true;
  const std::string searching = "[reg_status: KREG_STATUS_REGISTRATION_IN_PROGRESS]";
  EXPECT_EQ(told(Reports().update(state, moment)), (Told{{"EMM", searching}}));
  state.mayUseGsmOrUmts = true;
  state.packetAttached = false;
  EXPECT_EQ(told(Reports().update(state, moment)),
            (Told{{"EMM", searching}, {"MM", searching}, {"GMM", "[reg_status: KREG_STATUS_SERVICE_DETACHED]"}}));
  // Registered, but without a location.
  state.registration = Registration::home;
  EXPECT_EQ(told(Reports().update(state, moment)), Told{});
}

TEST(Reports, CoverTheModeOfOperationOfTheEpsContext) {
  ModemState state;
  state.technology = Technology::lte;
  state.epsMode = 4;
  EXPECT_EQ(told(Reports().update(state, moment)), (Told{{"EMM", "[ue_op_mode: EPS_UE_OP_MODE_CSPS_MODE_2]"}}));
}

TEST(Reports, CoverUmtsRegistrationWithItsAreas) {
  ModemState state = umtsHome();
  state.hsdpa = true;
  EXPECT_EQ(told(Reports().update(state, moment)),
            (Told{{"MM", "[reg_status: KREG_STATUS_NORMAL_SERVICE, lai: [encoded_plmn: <00 f1 10>, lac: 2828]]"},
                  {"GMM", "[reg_status: KREG_STATUS_NORMAL_SERVICE, rai: [encoded_plmn: <00 f1 10>, lac: 2828]]"},
                  {"UMTS cell",
                   "[mcc: 1, mnc: 1, lac: 2828, cell_id: 11259375, num_mnc_digits: 2, hspa: "
                   "SYS_HS_IND_HSDPA_SUPP_CELL]"}}));
}

TEST(Reports, WithdrawTheValuesOfTheOtherTechnology) {
  Reports reports;
  ModemState lte = lteHome();
  lte.lte.rsrp = -90;
  EXPECT_EQ(told(reports.update(lte, moment)).at("LTE level"), "[inst_values: [[rsrp0: -90]]]");
  const Told after = told(reports.update(umtsHome(), moment));
  EXPECT_EQ(after.at("EMM"), "[]");
  EXPECT_EQ(after.at("LTE cell"), "[]");
  EXPECT_EQ(after.at("LTE level"), "[inst_values: [[]]]");
  EXPECT_TRUE(after.contains("UMTS cell"));
  const Told back = told(reports.update(lteHome(), moment));
  EXPECT_EQ(back.at("UMTS cell"), "[]");
  EXPECT_EQ(back.at("MM"), "[]");
  EXPECT_EQ(back.at("GMM"), "[]");
}

TEST(Reports, TakeBackAllOfAModemThatHasVanishedOnce) {
  Reports reports;
  ModemState state = lteHome();
  state.bearersKnown = true;
  state.bearers.push_back(
      {.contextId = 1, .accessPoint = "internet", .families = {}, .ipv4 = {}, .ipv6 = {}, .dns = {}});
  state.cells.push_back(cell(Technology::lte, 1300, 7, -100, -12));
  state.sim.imsi = "001010123456789";
  const Told before = told(reports.update(state, moment));
  EXPECT_EQ(before.size(), 6U);
  EXPECT_TRUE(reports.simCardFiles(moment).has_value());
  EXPECT_EQ(told(reports.update({}, moment)), (Told{{"EMM", "[]"},
                                                    {"LTE cell", "[]"},
                                                    {"LTE neighbours", "[meas_nbr_eutra: [[]]]"},
                                                    {"bearers", "[bearer_contexts: [[]]]"},
                                                    {"common", "[]"},
                                                    {"SIM", "[ef_list: [[]]]"}}));
  EXPECT_EQ(reports.simCardFiles(moment), std::nullopt);
  EXPECT_EQ(told(reports.update({}, moment)), Told{});
}

TEST(Reports, CarryLteLevelsAsTheViewerReadsThem) {
  ModemState state;
  state.technology = Technology::lte;
  state.lte = {-93.6, -10.4, 12.3};
  EXPECT_EQ(told(Reports().update(state, moment)),
            (Told{{"LTE level", "[inst_values: [[rsrp0: -94, rsrq0: -10, sinr0: 25]]]"}}));
  state.lte = {-20.0, 30.0, 500.0};  // no phone measures these
  EXPECT_EQ(told(Reports().update(state, moment)), Told{});
}

TEST(Reports, CarryUmtsAndGsmLevels) {
  ModemState state;
  state.technology = Technology::umts;
  state.umts = {-71.0, -85.0, -6.5};
  EXPECT_EQ(told(Reports().update(state, moment)),
            (Told{{"UMTS level", "[rx_info: [[rssi: -71, rsrp_range: 31, rsrq_range: 36]]]"}}));
  state.technology = Technology::gsm;
  state.gsmRssi = -77.4;
  EXPECT_EQ(told(Reports().update(state, moment)), (Told{{"GSM level", "[idle_rxlev_dBm: -77]"}}));
}

TEST(Reports, TakeTheServingCellFromTheModemsCells) {
  ModemState state = lteHome();
  Cell serving = cell(Technology::lte, 1300, 185, -99.5, -11);
  serving.serving = true;
  serving.cellId = state.cellId;
  state.cells = {serving};
  const Told all = told(Reports().update(state, moment));
  EXPECT_EQ(all.at("LTE cell"),
            "[phy_cell_id: 185, dl_freq: 1300, cell_id: 29611237, freq_band_ind: 3, tracking_area_code: 6699, "
            "num_mnc_digits: 3, sel_plmn_mcc: 310, sel_plmn_mnc: 260]");
  EXPECT_EQ(all.at("LTE level"), "[inst_values: [[phy_cell_id: 185, rsrp0: -100, rsrq0: -11]]]");
  EXPECT_FALSE(all.contains("LTE neighbours"));
}

TEST(Reports, LeaveOutTheCarrierOfAnotherCellThanTheLocationNames) {
  ModemState state = lteHome();
  Cell before = cell(Technology::lte, 1300, 185, -99, -11);
  before.serving = true;
  before.cellId = 0x7777777;
  state.cells = {before};
  const Told all = told(Reports().update(state, moment));
  EXPECT_EQ(all.at("LTE cell").find("dl_freq"), std::string::npos);
  EXPECT_FALSE(all.contains("LTE level"));
}

TEST(Reports, CarryTheNeighboursOfLteInReportingCodes) {
  ModemState state;
  state.technology = Technology::lte;
  state.cells = {cell(Technology::lte, 6300, 12, -105, -14.5), cell(Technology::umts, 10700, 300, -95, -8),
                 gsmCell(62, 41, 37)};
  const Told all = told(Reports().update(state, moment));
  EXPECT_EQ(all.at("LTE neighbours"),
            "[meas_nbr_eutra: [[nbr_earfcn: 6300, nbr_phys_cell_id: 12, freq_band_ind: 20, nbr_rsrp: 35, "
            "nbr_rsrq: 10]]]");
  EXPECT_EQ(all.at("LTE others"),
            "[meas_nbr_utra: [[uarfcn: 10700, psc: 300, rscp: 21, ecno: 33]], meas_nbr_geran: [[arfcn: 62, bsic: 41, "
            "rxlev: 37]]]");
}

TEST(Reports, CarryTheNeighboursOfUmtsAndGsmUnderTheirOwnNames) {
  ModemState state;
  state.technology = Technology::umts;
  state.cells = {cell(Technology::umts, 10700, 300, -95, -8), gsmCell(62, 41, 37),
                 cell(Technology::lte, 6300, 12, -105, -14.5)};
  EXPECT_EQ(told(Reports().update(state, moment)).at("UMTS neighbours"),
            "[meas_utra_result: [[uarfcn: 10700, psc: 300, ecno: 33, rscp: 21]], meas_gsm_result: [[arfcn: 62, bsic: "
            "41, rxlev: 37]], meas_lte_result: [[earfcn: 6300, phy_cell_id: 12, eutra_band: 20, rsrp: 35, rsrq: 10]]]");
  state.technology = Technology::gsm;
  EXPECT_EQ(told(Reports().update(state, moment)).at("GSM neighbours"),
            "[gsm_ncell_meas: [[bsic: 41, arfcn: 62, rxlev: 37]], umts_ncell_meas: [[cpich_sc: 300, dl_uarfcn: 10700, "
            "cpich_rscp: 21, cpich_ecn0: 33]], lte_ncell_meas: [[physical_cell_id: 12, rsrp: 35, earfcn: 6300, rsrq: "
            "10]]]");
}

TEST(Reports, CloseOneListOfNeighboursAlone) {
  Reports reports;
  ModemState state;
  state.technology = Technology::umts;
  state.cells = {cell(Technology::umts, 10700, 300, -95, -8), gsmCell(62, 41, 37)};
  static_cast<void>(reports.update(state, moment));
  state.cells.pop_back();
  EXPECT_EQ(told(reports.update(state, moment)),
            (Told{{"UMTS neighbours",
                   "[meas_utra_result: [[uarfcn: 10700, psc: 300, ecno: 33, rscp: 21]], meas_gsm_result: [[]]]"}}));
}

TEST(Reports, CarryBearersWithTheirAddresses) {
  ModemState state;
  state.technology = Technology::lte;
  state.bearersKnown = true;
  Bearer both;
  both.contextId = 1;
  both.accessPoint = "internet";
  both.ipv4 = {10, 0, 0, 2};
  both.ipv6 = Bytes(16, 0x20);
  both.dns = {{9, 9, 9, 9}, Bytes(16, 0x26)};
  Bearer plain;
  plain.families = 1;
  state.bearers = {both, plain};
  const std::string ipv6 = "20 20 20 20 20 20 20 20 20 20 20 20 20 20 20 20";
  const std::string server = "26 26 26 26 26 26 26 26 26 26 26 26 26 26 26 26";
  EXPECT_EQ(told(Reports().update(state, moment)).at("bearers"),
            "[bearer_context_count: 2, bearer_contexts: [[cid: 1, apn: internet, pdp_type: PDP_TYPE_IPv4v6_PDN, "
            "pdp_addr: <0a 00 00 02 " +
                ipv6 +
                ">, primary_dns_type: PDP_TYPE_IPv4, primary_dns_addr: <09 09 09 09>, secondary_dns_type: "
                "PDP_TYPE_IPv6, secondary_dns_addr: <" +
                server + ">], [pdp_type: PDP_TYPE_IPv4_PDN]]]");
  state.technology = Technology::gsm;
  state.bearers = {plain};
  EXPECT_EQ(told(Reports().update(state, moment)).at("bearers"),
            "[bearer_context_count: 1, bearer_contexts: [[pdp_type: PDP_TYPE_IPv4]]]");
}

TEST(Reports, SayThatThereIsNoBearerWithoutMakingOneUp) {
  ModemState state;
  EXPECT_EQ(told(Reports().update(state, moment)), Told{});
  state.bearersKnown = true;
  EXPECT_EQ(told(Reports().update(state, moment)), (Told{{"bearers", "[bearer_context_count: 0]"}}));
}

}  // namespace
}  // namespace vespscope::test
