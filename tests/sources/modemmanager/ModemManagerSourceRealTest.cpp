// From a modem through the real ModemManager to the viewer's screens.
#include <signal.h>

#include <iostream>
#include <map>
#include <memory>
#include <mutex>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "BusCaller.h"
#include "Soon.h"
#include "Viewer.h"
#include "registry/MetricRows.h"
#include "sources/modemmanager/ModemManagerSource.h"
#include "sources/modemmanager/Names.h"
#include "sources/modemmanager/Probe.h"
#include "support/FakeModem.h"
#include "support/PrivateBus.h"
#include "support/Process.h"
#include "support/SimCardFilesOf.h"

namespace vespscope::test {
namespace {

using namespace sources;
using namespace sources::modemmanager;
using namespace std::chrono_literals;
using ::testing::HasSubstr;

constexpr const char* daemonPath = "/usr/sbin/ModemManager";
const std::string testInterface = "org.freedesktop.ModemManager1.Test";

// The maximum delay until a change is visible.
constexpr auto bar = 6s;

// Counts the delivered events.
class Events final : public EventSink {
 public:
  void deliver(MetricEvent event) override {
    const std::lock_guard lock(mutex_);
    ++counts_[event.metricID];
  }
  [[nodiscard]] std::size_t count(std::int32_t metricID) {
    const std::lock_guard lock(mutex_);
    return counts_[metricID];
  }

 private:
  std::mutex mutex_;
  std::map<std::int32_t, std::size_t> counts_;
};

class ModemManagerSourceReal : public ::testing::Test {
 protected:
  // A source without a manager.
  const Source& follow() {
    source_.start(events_);
    return source_;
  }

  void startDaemon() {
    daemon_ = std::make_unique<Process>(daemonPath,
                                        std::vector<std::string>{"--test-session", "--test-enable", "--no-auto-scan"});
    ASSERT_TRUE(soon([this] { return call(rootPath, objectManagerInterface, "GetManagedObjects").ok(); }))
        << daemon_->errors();
  }

  // Adds the modem to ModemManager, which queries it.
  void plugIn(const std::string& device = "modem") {
    const auto answer = call(rootPath, testInterface, "SetProfile",
                             {device, std::string("generic"), std::vector<std::string>{modem_.port()}});
    ASSERT_TRUE(answer.ok()) << answer.reason().words;
    ASSERT_TRUE(soon([this] { return !modemPath().empty(); })) << daemon_->errors();
  }

  // As a connection manager does; a diagnostic program does not.
  void enable(bool on = true) {
    const auto answer = call(modemPath(), modemInterface, "Enable", {on});
    ASSERT_TRUE(answer.ok()) << answer.reason().words;
  }

  std::string modemPath() {
    const auto answer = call(rootPath, objectManagerInterface, "GetManagedObjects");
    if (!answer || answer->empty() || answer->front().asDictionary() == nullptr) return {};
    const auto& objects = answer->front().asDictionary()->entries();
    return objects.empty() ? std::string() : objects.back().first;
  }

  bus::BusClient::Answer call(const std::string& path, const std::string& interface, const std::string& member,
                              std::vector<bus::BusArgument> arguments = {}) {
    return caller_.call({service, path, interface, member, std::move(arguments)});
  }

  void start() {
    startDaemon();
    plugIn();
    enable();
  }

  // Changes the modem's facts, and waits until a screen shows the change.
  void expectShown(const FakeModem::Facts& facts, const std::string& launch, const std::string& row,
                   const std::string& label, const std::string& value) {
    modem_.set(facts);
    const auto took =
        Viewer::runUntil([&] { return Viewer::value(launch, row, label) == value; }, std::chrono::milliseconds(bar));
    ASSERT_TRUE(took) << label << " is " << Viewer::value(launch, row, label);
    std::cout << launch << " " << row << " " << label << " " << value << " after " << took->count() << " ms\n";
  }

  PrivateBus bus_;
  FakeModem modem_;
  BusCaller caller_;
  std::unique_ptr<Process> daemon_;
  Events events_;
  ModemManagerSource source_;
};

TEST_F(ModemManagerSourceReal, IsShownAsFarAsItReports) {
  start();
  const Viewer viewer("modemmanager");
  ASSERT_TRUE(Viewer::runUntil([] { return Viewer::value("LTE", "Serving Cell Meas", "rsrp0") != "(no row)"; }));
  ASSERT_TRUE(Viewer::runUntil([] { return Viewer::value("Device Info", "SIM Files", "ef_id") == "12258"; }));
  ASSERT_TRUE(Viewer::runUntil([] { return Viewer::value("LTE", "Serving Cell Info", "cell_id") != "(no row)"; }));
  ASSERT_TRUE(Viewer::runUntil([] { return Viewer::labels("LTE", "NAS") == "timestamp reg_status"; }));
  EXPECT_EQ(Viewer::value("LTE", "NAS", "reg_status"), "KREG_STATUS_NORMAL_SERVICE");
  EXPECT_EQ(Viewer::value("LTE", "Serving Cell Info", "cell_id"), std::to_string(0x01C3D4E5));
  EXPECT_EQ(Viewer::value("LTE", "Serving Cell Info", "tracking_area_code"), std::to_string(0x1A2B));
  EXPECT_EQ(Viewer::value("LTE", "Serving Cell Info", "sel_plmn_mcc"), "1");
  EXPECT_EQ(Viewer::value("LTE", "Serving Cell Info", "num_mnc_digits"), "2");
  EXPECT_EQ(Viewer::value("LTE", "Serving Cell Meas", "rsrp0"), "-81");  // code 60
  EXPECT_EQ(Viewer::value("LTE", "Serving Cell Meas", "rsrq0"), "-10");  // code 20, -9.5 dB, as ModemManager rounds
  EXPECT_TRUE(Viewer::runUntil([] { return Viewer::sourceLabel() == "Vespscope Fake Modem, registered"; }))
      << Viewer::sourceLabel();
  // This modem reports neither channel nor bandwidth, neighbours or RRC state.
  EXPECT_EQ(Viewer::labels("LTE", "Serving Cell Info"),
            "timestamp cell_id tracking_area_code num_mnc_digits sel_plmn_mcc sel_plmn_mnc");
  EXPECT_EQ(Viewer::labels("LTE", "Serving Cell Meas"), "rsrp0 rsrq0 timestamp");
  EXPECT_EQ(Viewer::labels("LTE", "RRC State"), "");
  EXPECT_EQ(Viewer::labels("LTE", "NAS"), "timestamp reg_status");
  EXPECT_EQ(Viewer::labels("UMTS", "NAS MM"), "");

  const auto files = Viewer::screen("Device Info", "SIM Files");
  ASSERT_EQ(files.sections.size(), 4U);
  const auto file = [&files](std::size_t section) { return *files.sections[section].rows[1].value; };
  EXPECT_EQ(file(0), "<98 99 10 00 00 00 00 00 10 f8>");                       // EF_ICCID
  EXPECT_EQ(file(1), "<08 09 10 10 10 32 54 76 98>");                          // EF_IMSI
  EXPECT_EQ(file(2), "<ff ff ff 02>");                                         // EF_AD
  EXPECT_EQ(file(3), "<ff 54 65 73 74 20 4e 65 74 77 6f 72 6b ff ff ff ff>");  // EF_SPN
}

TEST_F(ModemManagerSourceReal, IsUpdatedWithinSixSecondsOfAChange) {
  start();
  const Viewer viewer("modemmanager");
  ASSERT_TRUE(Viewer::runUntil([] { return Viewer::value("LTE", "Serving Cell Info", "cell_id") != "(no row)"; }));
  ASSERT_TRUE(Viewer::runUntil([] { return Viewer::value("LTE", "Serving Cell Meas", "rsrp0") == "-81"; }));
  FakeModem::Facts facts = modem_.facts();

  facts.cellId = "01C3D4E6";
  expectShown(facts, "LTE", "Serving Cell Info", "cell_id", std::to_string(0x01C3D4E6));
  facts.area = "1A2C";
  expectShown(facts, "LTE", "Serving Cell Info", "tracking_area_code", std::to_string(0x1A2C));
  facts.rsrp = 40;
  expectShown(facts, "LTE", "Serving Cell Meas", "rsrp0", "-101");
  facts.registration = 2;
  expectShown(facts, "LTE", "NAS", "reg_status", "KREG_STATUS_REGISTRATION_IN_PROGRESS");
  facts.registration = 3;
  expectShown(facts, "LTE", "NAS", "reg_status", "KREG_STATUS_REGISTRATION_FAILURE");
  facts.registration = 1;
  expectShown(facts, "LTE", "NAS", "reg_status", "KREG_STATUS_NORMAL_SERVICE");
  // The modem was handed over to another technology.
  facts.technology = 2;
  facts.area = "0B0C";
  facts.cellId = "00ABCDEF";
  facts.rsrp = facts.rsrq = 255;
  facts.rscp = 50;
  facts.ecno = 30;
  expectShown(facts, "UMTS", "Serving Cell Info", "cell_id", std::to_string(0x00ABCDEF));
  EXPECT_TRUE(Viewer::runUntil([] { return Viewer::labels("LTE", "Serving Cell Info") == "timestamp"; }));
  EXPECT_TRUE(Viewer::runUntil([] { return Viewer::labels("LTE", "NAS") == "timestamp"; }));
  EXPECT_EQ(Viewer::value("UMTS", "NAS MM", "reg_status"), "KREG_STATUS_NORMAL_SERVICE");
}

// ModemManager reads a card when the modem is enabled: another card makes it start again with the modem.
TEST_F(ModemManagerSourceReal, ShowsAnotherSimCardWithinSixSecondsOfItsDiscovery) {
  start();
  const Viewer viewer("modemmanager");
  ASSERT_TRUE(Viewer::runUntil([] { return Viewer::value("Device Info", "SIM Files", "ef_id") == "12258"; }));
  FakeModem::Facts facts = modem_.facts();
  facts.iccid = "8999020000000000017";
  facts.imsi = "999700123456789";
  facts.providerName = "Other Network";
  modem_.set(facts);
  enable(false);
  enable(true);
  const auto content = [] {
    const auto files = Viewer::screen("Device Info", "SIM Files");
    return files.sections.front().rows.size() < 2 ? std::string() : files.sections.front().rows[1].value.value_or("");
  };
  const auto took = Viewer::runUntil([&] { return content() == "<98 99 20 00 00 00 00 00 10 f7>"; }, 20s);
  ASSERT_TRUE(took) << content();
  std::cout << "SIM card after " << took->count() << " ms\n";
}

TEST_F(ModemManagerSourceReal, IsTakenBackWhenModemManagerEndsAndTakenUpWhenItIsBack) {
  start();
  const Viewer viewer("modemmanager");
  ASSERT_TRUE(Viewer::runUntil([] { return Viewer::value("LTE", "Serving Cell Info", "cell_id") != "(no row)"; }));
  ASSERT_TRUE(Viewer::runUntil([] { return Viewer::value("Device Info", "SIM Files", "ef_id") == "12258"; }));
  ASSERT_TRUE(Viewer::runUntil([] { return Viewer::value("LTE", "Serving Cell Meas", "rsrp0") != "(no row)"; }));
  ASSERT_TRUE(Viewer::runUntil([] { return Viewer::labels("LTE", "NAS") == "timestamp reg_status"; }));
  daemon_.reset();
  EXPECT_TRUE(Viewer::runUntil([] { return Viewer::labels("LTE", "NAS") == "timestamp"; }));
  EXPECT_TRUE(Viewer::runUntil([] { return Viewer::labels("LTE", "Serving Cell Info") == "timestamp"; }));
  EXPECT_TRUE(Viewer::runUntil([] { return Viewer::labels("LTE", "Serving Cell Meas") == "timestamp"; }));
  EXPECT_TRUE(Viewer::runUntil([] { return Viewer::labels("Device Info", "SIM Files") == "timestamp"; }));
  EXPECT_TRUE(Viewer::runUntil([] { return Viewer::sourceLabel() == "no ModemManager, waiting for it"; }));
  start();
  EXPECT_TRUE(Viewer::runUntil([] { return Viewer::labels("LTE", "NAS") == "timestamp reg_status"; }));
  EXPECT_TRUE(Viewer::runUntil([] { return Viewer::value("LTE", "Serving Cell Meas", "rsrp0") == "-81"; }));
  EXPECT_TRUE(Viewer::runUntil([] { return Viewer::value("Device Info", "SIM Files", "ef_id") == "12258"; }));
}

TEST_F(ModemManagerSourceReal, ThatIsNotEnabledIsSaidToBeSo) {
  startDaemon();
  EXPECT_FALSE(modemManagerHasModem());
  const Source& source = follow();
  EXPECT_TRUE(soon([&] { return source.label() == "no modem, waiting for one"; }));
  plugIn();
  EXPECT_TRUE(modemManagerHasModem());
  EXPECT_TRUE(soon([&] { return source.label() == "Vespscope Fake Modem, disabled"; }));
  // Its identity is reported before it is enabled, its location is not.
  EXPECT_TRUE(soon([this] { return simCardFilesOf(source_).has_value(); }));
  EXPECT_EQ(events_.count(metricIdentifier("K_LTE_SCELL_INFO")), 0U);
  EXPECT_EQ(events_.count(metricIdentifier("K_LTE_EMM_CTXT")), 0U);
}

// A modem that reports only a quality in percent has no levels to show.
TEST_F(ModemManagerSourceReal, WithoutExtendedSignalHasNoLevels) {
  FakeModem::Facts facts;
  facts.extendedSignal = false;
  modem_.set(facts);
  start();
  follow();
  EXPECT_TRUE(soon([this] { return events_.count(metricIdentifier("K_LTE_SCELL_INFO")) > 0; }));
  EXPECT_TRUE(soon([this] { return simCardFilesOf(source_).has_value(); }));
  EXPECT_THAT(modem_.commands(), ::testing::Contains("AT+CESQ=?"));
  EXPECT_EQ(events_.count(metricIdentifier("K_LTE_RSRP_RSRQ_SINR")), 0U);
}

TEST_F(ModemManagerSourceReal, IsLeftWithTheSignalRateItWasFoundWith) {
  start();
  const auto rate = [this] {
    const auto answer = call(modemPath(), propertiesInterface, "Get", {signalInterface, std::string("Rate")});
    return answer ? std::get<std::uint64_t>(answer->front().data()) : 99;
  };
  ASSERT_EQ(rate(), 0U);
  follow();
  EXPECT_TRUE(soon([&] { return rate() == 1; }));
  source_.stop();
  EXPECT_TRUE(soon([&] { return rate() == 0; }));
}

TEST(ModemManagerSourceRealWithoutABus, TheSourceSaysSoAndTheProbeSaysNo) {
  useNoBus();
  EXPECT_FALSE(modemManagerHasModem());
  Events events;
  ModemManagerSource source;
  source.start(events);
  EXPECT_TRUE(soon([&] { return source.label().starts_with("ModemManager is unreachable (no system bus: "); }))
      << source.label();
}

TEST(ModemManagerSourceRealAbsent, TheSourceWaitsAndTheProbeSaysNo) {
  const PrivateBus bus;
  EXPECT_FALSE(modemManagerHasModem());
  Events events;
  ModemManagerSource source;
  source.start(events);
  EXPECT_TRUE(soon([&] { return source.label() == "no ModemManager, waiting for it"; })) << source.label();
  EXPECT_EQ(simCardFilesOf(source), std::nullopt);
}

TEST(ModemManagerSourceRealBusEnd, IsOpenedAgainWhenItIsBack) {
  PrivateBus bus;
  Events events;
  ModemManagerSource source({}, 50ms);
  source.start(events);
  const std::string waiting = "no ModemManager, waiting for it";
  ASSERT_TRUE(soon([&] { return source.label() == waiting; }));
  bus.stop();
  EXPECT_TRUE(soon([&] { return source.label().find("system bus") != std::string::npos; }));
  bus.start();
  EXPECT_TRUE(soon([&] { return source.label() == waiting; })) << source.label();
}

}  // namespace
}  // namespace vespscope::test
