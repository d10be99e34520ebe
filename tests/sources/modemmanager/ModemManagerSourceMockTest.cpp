// The source with a ModemManager controlled by the test: values that AT modems cannot provide, and faults.
#include <cfloat>
#include <chrono>
#include <map>
#include <memory>
#include <mutex>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "DecodedEvents.h"
#include "Soon.h"
#include "Viewer.h"
#include "sources/modemmanager/ModemManagerSource.h"
#include "sources/modemmanager/Names.h"
#include "sources/modemmanager/Probe.h"
#include "support/FakeModemManager.h"
#include "support/PrivateBus.h"
#include "support/SimCardFilesOf.h"

namespace vespscope::test {
namespace {

using namespace sources;
using namespace sources::modemmanager;
using namespace std::chrono_literals;
using ::testing::HasSubstr;

const std::string modem = "/org/freedesktop/ModemManager1/Modem/0";
const std::string sim = "/org/freedesktop/ModemManager1/SIM/0";
const std::string bearer = "/org/freedesktop/ModemManager1/Bearer/0";

constexpr std::uint32_t lteBit = 1U << 14U;
constexpr std::uint32_t umtsBit = 1U << 5U;

// Stores the last event of each metric.
class LastEvents final : public EventSink {
 public:
  void deliver(MetricEvent event) override {
    const auto [name, text] = decodedEvent(event);
    const std::lock_guard lock(mutex_);
    texts_[name] = text;
  }
  // "(none)" if there was none.
  [[nodiscard]] std::string of(const std::string& name) {
    const std::lock_guard lock(mutex_);
    const auto found = texts_.find(name);
    return found == texts_.end() ? "(none)" : found->second;
  }

 private:
  std::mutex mutex_;
  std::map<std::string, std::string> texts_;
};

Pace quickPace() { return {.location = 20ms, .cells = 20ms, .retry = 50ms, .timeout = 200ms, .signalSeconds = 1}; }

BusProperties lteCell(bool serving, std::uint32_t channel, const char* physical, double power) {
  return {{"cell-type", busNumber(5)},        {"serving", busFlag(serving)}, {"earfcn", busNumber(channel)},
          {"physical-ci", busText(physical)}, {"rsrp", busReal(power)},      {"rsrq", busReal(-10.5)}};
}

class ModemManagerSourceMock : public ::testing::Test {
 protected:
  // A modem with QMI: registered in LTE, with everything that ModemManager can report.
  void plugIn(const std::string& path = modem) {
    manager_.add(path, {{modemInterface,
                         {{"State", busInteger(8)},
                          {"Manufacturer", busText("Acme")},
                          {"Model", busText("QMI 9000")},
                          {"AccessTechnologies", busNumber(lteBit)},
                          {"CurrentCapabilities", busNumber(12)},
                          {"Sim", busPath("/")},
                          {"Bearers", busPaths({})}}},
                        {modem3gppInterface,
                         {{"RegistrationState", busNumber(1)},
                          {"OperatorCode", busText("310260")},
                          {"PacketServiceState", busNumber(2)},
                          {"InitialEpsBearer", busPath("/")}}},
                        {locationInterface, {{"Enabled", busNumber(1)}}},
                        {signalInterface, {{"Rate", busNumber(0)}, {"Lte", busDictionary({})}}}});
    setLocation("310,260,FFFE,1C3D4E5,1A2B");
    setCells({});
  }

  void setLocation(const std::string& words) { manager_.reply("GetLocation", busNumbered(1, busText(words))); }
  void setCells(std::vector<BusProperties> cells) { manager_.reply("GetCellInfo", busDictionaries(std::move(cells))); }

  void start() { source_.start(events_); }

  // Waits until the source reports `text` for the metric; otherwise the test fails and prints the last report.
  void expect(const std::string& name, const std::string& text) {
    EXPECT_TRUE(soon([&] { return events_.of(name) == text; })) << name << " is " << events_.of(name);
  }
  void expectLabel(const std::string& label) {
    EXPECT_TRUE(soon([&] { return source_.label() == label; })) << source_.label();
  }

  // All values of the lost modem have been withdrawn.
  void expectNothingLeft() {
    for (const char* name : {"EMM", "LTE cell"}) expect(name, "[]");
  }

  PrivateBus bus_;
  FakeModemManager manager_;
  LastEvents events_;
  ModemManagerSource source_{quickPace(), 50ms};
};

const std::string lteCellInfo =
    "[cell_id: 29611237, tracking_area_code: 6699, num_mnc_digits: 3, sel_plmn_mcc: 310, sel_plmn_mnc: 260]";

TEST_F(ModemManagerSourceMock, ReportsItsCellsAndNeighbours) {
  plugIn();
  start();
  expect("LTE cell", lteCellInfo);
  setCells({lteCell(true, 1300, "B9", -99.5),
            lteCell(false, 6300, "C", -105.0),
            {{"cell-type", busNumber(3)},
             {"serving", busFlag(false)},
             {"uarfcn", busNumber(10700)},
             {"psc", busNumber(300)}}});
  expect("LTE cell",
         "[phy_cell_id: 185, dl_freq: 1300, cell_id: 29611237, freq_band_ind: 3, tracking_area_code: 6699, "
         "num_mnc_digits: 3, sel_plmn_mcc: 310, sel_plmn_mnc: 260]");
  expect("LTE level", "[inst_values: [[phy_cell_id: 185, rsrp0: -100, rsrq0: -11]]]");
  expect("LTE neighbours",
         "[meas_nbr_eutra: [[nbr_earfcn: 6300, nbr_phys_cell_id: 12, freq_band_ind: 20, nbr_rsrp: 35, nbr_rsrq: 18]]]");
  expect("LTE others", "[meas_nbr_utra: [[uarfcn: 10700, psc: 300]]]");
  setCells({});
  expect("LTE neighbours", "[meas_nbr_eutra: [[]]]");
  expect("LTE others", "[meas_nbr_utra: [[]]]");
  expect("LTE cell", lteCellInfo);
}

TEST_F(ModemManagerSourceMock, ReportsExtendedSignalAsItChanges) {
  plugIn();
  start();
  EXPECT_TRUE(soon([this] { return manager_.calls("Setup") == 1; }));
  const auto lte = [](double rsrp, double rsrq, double snr) {
    return BusProperties{
        {"Lte", busDictionary({{"rsrp", busReal(rsrp)}, {"rsrq", busReal(rsrq)}, {"snr", busReal(snr)}})}};
  };
  manager_.change(modem, signalInterface, lte(-93.6, -10.4, 12.3));
  expect("LTE level", "[inst_values: [[rsrp0: -94, rsrq0: -10, sinr0: 25]]]");
  manager_.change(modem, signalInterface, lte(-93.6, -DBL_MAX, -DBL_MAX));
  expect("LTE level", "[inst_values: [[rsrp0: -94]]]");
  manager_.invalidate(modem, signalInterface, "Lte");
  expect("LTE level", "[inst_values: [[]]]");
}

// Another client has configured ModemManager to gather positions (2) and not the cell.
TEST_F(ModemManagerSourceMock, IsMadeToGatherItsCellAndLeftAsItWasFound) {
  plugIn();
  manager_.change(modem, locationInterface, {{"Enabled", busNumber(2)}, {"Capabilities", busNumber(7)}});
  start();
  EXPECT_TRUE(soon([this] { return manager_.setUp(locationInterface) == 3U; }));
  EXPECT_TRUE(soon([this] { return manager_.setUp(signalInterface) == 1U; }));
  expect("LTE cell", lteCellInfo);
  source_.stop();
  EXPECT_TRUE(soon([this] { return manager_.setUp(locationInterface) == 2U; }));
  EXPECT_TRUE(soon([this] { return manager_.setUp(signalInterface) == 0U; }));
}

TEST_F(ModemManagerSourceMock, ReportsItsBearersWhileTheyAreConnected) {
  plugIn();
  start();
  expect("bearers", "[bearer_context_count: 0]");
  manager_.add(bearer, {{bearerInterface,
                         {{"Connected", busFlag(false)},
                          {"ProfileId", busInteger(-1)},
                          {"Properties", busDictionary({{"apn", busText("internet")}, {"ip-type", busNumber(1)}})},
                          {"Ip4Config", busDictionary({})},
                          {"Ip6Config", busDictionary({})}}}});
  manager_.change(modem, modemInterface, {{"Bearers", busPaths({bearer})}});
  EXPECT_TRUE(soon([this] { return manager_.calls("GetAll") == 1; }));
  manager_.change(bearer, bearerInterface,
                  {{"Connected", busFlag(true)},
                   {"Ip4Config", busDictionary({{"address", busText("10.0.0.2")}, {"dns1", busText("9.9.9.9")}})}});
  expect("bearers",
         "[bearer_context_count: 1, bearer_contexts: [[apn: internet, pdp_type: PDP_TYPE_IPv4_PDN, pdp_addr: "
         "<0a 00 00 02>, primary_dns_type: PDP_TYPE_IPv4, primary_dns_addr: <09 09 09 09>]]]");
  manager_.change(bearer, bearerInterface, {{"Connected", busFlag(false)}});
  expect("bearers", "[bearer_context_count: 0, bearer_contexts: [[]]]");
}

TEST_F(ModemManagerSourceMock, ReportsAnotherSimCardAtOnce) {
  manager_.add(sim, {{simInterface, {{"Imsi", busText("310260123456789")}}}});
  plugIn();
  manager_.change(modem, modemInterface, {{"Sim", busPath(sim)}});
  start();
  expect("common", "[imsi: <39 01 62 10 32 54 76 98>]");
  manager_.change(sim, simInterface, {{"Imsi", busText("001010123456789")}});
  expect("common", "[imsi: <09 10 10 10 32 54 76 98>]");
  expect("SIM", "[ef_list: [[ef_id: 28423, content: <08 09 10 10 10 32 54 76 98>]]]");
  EXPECT_TRUE(simCardFilesOf(source_).has_value());
  manager_.change(modem, modemInterface, {{"Sim", busPath("/")}});
  expect("SIM", "[ef_list: [[]]]");
  expect("common", "[]");
  EXPECT_EQ(simCardFilesOf(source_), std::nullopt);
}

TEST_F(ModemManagerSourceMock, ChangesItsTechnology) {
  plugIn();
  start();
  expect("LTE cell", lteCellInfo);
  setLocation("310,260,B0C,ABCDEF,0");
  manager_.change(modem, modemInterface, {{"AccessTechnologies", busNumber(umtsBit)}});
  expect("UMTS cell", "[mcc: 310, mnc: 260, lac: 2828, cell_id: 11259375, num_mnc_digits: 3]");
  expect("GMM", "[reg_status: KREG_STATUS_NORMAL_SERVICE, rai: [encoded_plmn: <13 00 62>, lac: 2828]]");
  expectNothingLeft();
  manager_.change(modem, modemInterface, {{"AccessTechnologies", busNumber(0)}});
  expect("UMTS cell", "[]");
}

TEST_F(ModemManagerSourceMock, WithdrawsAllValuesOfALostModem) {
  plugIn();
  start();
  expect("LTE cell", lteCellInfo);
  expectLabel("Acme QMI 9000, registered");
  EXPECT_TRUE(modemManagerHasModem());
  manager_.remove(modem);
  expectNothingLeft();
  expectLabel("no modem, waiting for one");
  EXPECT_FALSE(modemManagerHasModem());
  plugIn("/org/freedesktop/ModemManager1/Modem/1");
  expect("LTE cell", lteCellInfo);
  expectLabel("Acme QMI 9000, registered");
}

TEST_F(ModemManagerSourceMock, IsFoundByThePortsThatItLists) {
  plugIn("/org/freedesktop/ModemManager1/Modem/3");
  EXPECT_FALSE(modemManagerPort("ttyUSB2").modem);
  manager_.change("/org/freedesktop/ModemManager1/Modem/3", modemInterface,
                  {{"Ports", busPorts({"cdc-wdm0", "ttyUSB2"})}, {"Device", busText("/sys/devices/usb1/1-4")}});
  const auto port = modemManagerPort("ttyUSB2");
  EXPECT_TRUE(port.running);
  EXPECT_EQ(port.modem, "3");
  EXPECT_EQ(port.device, "/sys/devices/usb1/1-4");
  EXPECT_TRUE(modemManagerPort("ttyUSB0").running);
  EXPECT_FALSE(modemManagerPort("ttyUSB0").modem);
}

TEST_F(ModemManagerSourceMock, VanishesWhileItIsAsked) {
  plugIn();
  manager_.answer("GetCellInfo", {FakeModemManager::Answer::Manner::silence, {}, {}});
  start();
  expect("LTE cell", lteCellInfo);
  EXPECT_TRUE(soon([this] { return manager_.calls("GetCellInfo") > 0; }));
  manager_.remove(modem);
  expectNothingLeft();
  // Its successor is queried again, and an answer for the previous modem would be ignored.
  plugIn("/org/freedesktop/ModemManager1/Modem/1");
  setCells({lteCell(true, 1300, "B9", -99.5)});
  expect("LTE level", "[inst_values: [[phy_cell_id: 185, rsrp0: -100, rsrq0: -11]]]");
}

TEST_F(ModemManagerSourceMock, IsTheOneWithTheLowestNumberAndStaysIt) {
  plugIn("/org/freedesktop/ModemManager1/Modem/10");
  manager_.add("/org/freedesktop/ModemManager1/Modem/9",
               {{modemInterface, {{"State", busInteger(3)}, {"Model", busText("Nine")}}}});
  start();
  expectLabel("Nine, disabled, one of 2 modems");
  manager_.add("/org/freedesktop/ModemManager1/Modem/2",
               {{modemInterface, {{"State", busInteger(2)}, {"Model", busText("Two")}}}});
  expectLabel("Nine, disabled, one of 3 modems");
  manager_.remove("/org/freedesktop/ModemManager1/Modem/9");
  expectLabel("Two, locked, one of 2 modems");
}

TEST_F(ModemManagerSourceMock, ThatIsDisabledIsNotAskedWhereItIs) {
  plugIn();
  start();
  expect("LTE cell", lteCellInfo);
  manager_.change(modem, modemInterface, {{"State", busInteger(3)}});
  expectLabel("Acme QMI 9000, disabled");
  expect("LTE cell", "[num_mnc_digits: 3, sel_plmn_mcc: 310, sel_plmn_mnc: 260]");
}

TEST_F(ModemManagerSourceMock, ThatDoesNotOfferCellsIsAskedOnce) {
  plugIn();
  manager_.fail("GetCellInfo", "org.freedesktop.ModemManager1.Error.Core.Unsupported");
  start();
  expect("LTE cell", lteCellInfo);
  EXPECT_TRUE(soon([this] { return manager_.calls("GetLocation") > 10; }));
  EXPECT_EQ(manager_.calls("GetCellInfo"), 1);
}

TEST_F(ModemManagerSourceMock, LeavesOutWhatIsRefusedAndTakesItUpWhenItIsGranted) {
  plugIn();
  const std::string unauthorized = "org.freedesktop.ModemManager1.Error.Core.Unauthorized";
  for (const char* method : {"GetLocation", "GetCellInfo", "Setup"}) manager_.fail(method, unauthorized);
  start();
  expect("EMM", "[reg_status: KREG_STATUS_NORMAL_SERVICE]");
  expect("LTE cell", "[num_mnc_digits: 3, sel_plmn_mcc: 310, sel_plmn_mnc: 260]");
  EXPECT_TRUE(soon([this] { return manager_.calls("Setup") > 1 && manager_.calls("GetCellInfo") > 1; }));
  setLocation("310,260,FFFE,1C3D4E5,1A2B");
  setCells({lteCell(true, 1300, "B9", -99.5)});
  expect("LTE level", "[inst_values: [[phy_cell_id: 185, rsrp0: -100, rsrq0: -11]]]");
  EXPECT_THAT(events_.of("LTE cell"), HasSubstr("cell_id: 29611237"));
}

TEST_F(ModemManagerSourceMock, WithdrawsALocationThatIsNoLongerReported) {
  plugIn();
  start();
  expect("LTE cell", lteCellInfo);
  manager_.fail("GetLocation", "org.freedesktop.ModemManager1.Error.Core.Unauthorized");
  expect("LTE cell", "[num_mnc_digits: 3, sel_plmn_mcc: 310, sel_plmn_mnc: 260]");
}

TEST_F(ModemManagerSourceMock, ThatAnswersTooLateIsAskedAgain) {
  plugIn();
  const FakeModemManager::Answer silence{FakeModemManager::Answer::Manner::silence, {}, {}};
  for (const char* method : {"GetLocation", "GetCellInfo", "Setup", "GetAll"}) manager_.answer(method, silence);
  manager_.add(sim, {{simInterface, {{"Imsi", busText("310260123456789")}}}});
  manager_.change(modem, modemInterface, {{"Sim", busPath(sim)}});
  start();
  for (const char* method : {"GetLocation", "GetCellInfo", "Setup", "GetAll"}) {
    EXPECT_TRUE(soon([&] { return manager_.calls(method) > 1; })) << method;
  }
  EXPECT_EQ(events_.of("common"), "(none)");
  setLocation("310,260,FFFE,1C3D4E5,1A2B");
  expect("LTE cell", lteCellInfo);
}

TEST_F(ModemManagerSourceMock, IsFoundWhenModemManagerAnswersOnlyLater) {
  manager_.answer("GetManagedObjects", {FakeModemManager::Answer::Manner::silence, {}, {}});
  EXPECT_FALSE(modemManagerHasModem(100ms));
  start();
  EXPECT_TRUE(soon([this] { return manager_.calls("GetManagedObjects") > 2; }));
  expectLabel("asking ModemManager for its modems");
  manager_.fail("GetManagedObjects", "org.freedesktop.DBus.Error.AccessDenied");
  const int before = manager_.calls("GetManagedObjects");
  EXPECT_TRUE(soon([&] { return manager_.calls("GetManagedObjects") > before + 1; }));
  EXPECT_FALSE(modemManagerHasModem());
  manager_.reply("GetManagedObjects", busText("none of your business"));
  EXPECT_FALSE(modemManagerHasModem());
}

TEST_F(ModemManagerSourceMock, IgnoresAnswersOfOtherTypes) {
  plugIn();
  manager_.reply("GetLocation", busText("here"));
  manager_.reply("GetCellInfo", busNumber(5));
  manager_.reply("GetAll", busNumber(5));
  manager_.add(sim, {});
  manager_.change(modem, modemInterface, {{"Sim", busPath(sim)}});
  start();
  expect("EMM", "[reg_status: KREG_STATUS_NORMAL_SERVICE]");
  EXPECT_TRUE(soon([this] { return manager_.calls("GetLocation") > 10; }));
  EXPECT_LT(manager_.calls("GetAll"), manager_.calls("GetLocation") * 10) << "asked again without a pause";
  manager_.change(modem, modem3gppInterface, {{"RegistrationState", busText("home")}});
  expect("EMM", "[]");
  manager_.change(modem, modemInterface, {{"State", busText("registered")}, {"Bearers", busNumber(1)}});
  expectLabel("Acme QMI 9000, in an unknown state");
  EXPECT_EQ(events_.of("SIM"), "(none)");
  EXPECT_EQ(events_.of("LTE level"), "(none)");
}

TEST(ModemManagerSourceMockInTheViewer, IsOnItsScreensAndVanishesFromThem) {
  const PrivateBus bus;
  FakeModemManager manager;
  manager.add(bearer, {{bearerInterface,
                        {{"Connected", busFlag(true)},
                         {"ProfileId", busInteger(1)},
                         {"Properties", busDictionary({{"apn", busText("internet")}})},
                         {"Ip4Config", busDictionary({{"address", busText("10.0.0.2")}})}}}});
  manager.reply("GetLocation", busNumbered(1, busText("310,260,FFFE,1C3D4E5,1A2B")));
  manager.reply("GetCellInfo", busDictionaries({lteCell(true, 1300, "B9", -99.5), lteCell(false, 6300, "C", -105.0)}));
  manager.add(
      modem, {{modemInterface,
               {{"State", busInteger(11)}, {"AccessTechnologies", busNumber(lteBit)}, {"Bearers", busPaths({bearer})}}},
              {modem3gppInterface, {{"RegistrationState", busNumber(1)}, {"OperatorCode", busText("310260")}}},
              {locationInterface, {}},
              {signalInterface,
               {{"Rate", busNumber(1)}, {"Lte", busDictionary({{"rsrp", busReal(-90.0)}, {"snr", busReal(12.3)}})}}}});
  const Viewer viewer("modemmanager");
  EXPECT_TRUE(Viewer::runUntil([] { return Viewer::value("LTE", "Serving Cell Info", "dl_freq") == "1300"; }));
  EXPECT_TRUE(Viewer::runUntil([] { return Viewer::value("LTE", "Serving Cell Meas", "rsrp0") == "-90"; }));
  EXPECT_EQ(Viewer::value("LTE", "Serving Cell Meas", "sinr0"), "12.5");
  EXPECT_TRUE(Viewer::runUntil([] { return Viewer::value("LTE", "Active Bearers", "apn") == "internet"; }));
  EXPECT_TRUE(Viewer::runUntil([] { return Viewer::value("LTE", "LTE Neighbor Cell Meas", "nbr_rsrp") == "-105"; }));
  EXPECT_EQ(Viewer::value("LTE", "LTE Neighbor Cell Meas", "nbr_rsrq"), "-10.5");
  manager.remove(modem);
  for (const char* row :
       {"NAS", "Serving Cell Info", "Serving Cell Meas", "Active Bearers", "LTE Neighbor Cell Meas"}) {
    EXPECT_TRUE(Viewer::runUntil([row] { return Viewer::labels("LTE", row) == "timestamp"; })) << row;
  }
}

}  // namespace
}  // namespace vespscope::test
