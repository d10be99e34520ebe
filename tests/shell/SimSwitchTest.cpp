// The switch between SIM cards while the whole application runs: screens, status and ages follow it.
#include <chrono>
#include <cstdlib>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "messages/lte/KCellularLteRrcState.h"
#include "messages/lte/KCellularLteScellInfo.h"
#include "messages/lte/LteRrcState.h"
#include "metrics/MetricValidator.h"
#include "platform/application/Application.h"
#include "platform/application/StatusText.h"
#include "platform/application/TableSnapshot.h"
#include "platform/dispatch/MainLoop.h"
#include "registry/MetricRows.h"
#include "rhoxlink/Rhoxlink.h"
#include "shell/AppDelegate.h"
#include "shell/ConnectionFacts.h"
#include "shell/MainInterface.h"
#include "shell/ScreenAges.h"
#include "shell/SimSwitch.h"
#include "support/FakeManager.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {
namespace {

using application::readTable;
using application::TableViewController;
using dispatch::MainLoop;

bool runUntil(const std::function<bool()>& condition) {
  const auto end = std::chrono::steady_clock::now() + std::chrono::seconds(5);
  while (!condition()) {
    if (std::chrono::steady_clock::now() > end) return false;
    MainLoop::main().runOnce(std::chrono::milliseconds(20));
  }
  return true;
}

// Runs a test's steps where an interface would draw.
class SwitchSteps : public application::Frontend {
 public:
  explicit SwitchSteps(std::function<void(application::Application&)> steps) : steps_(std::move(steps)) {}
  int run(application::Application& application) override {
    steps_(application);
    return 0;
  }

 private:
  std::function<void(application::Application&)> steps_;
};

class SimSwitchTest : public testing::Test {
 protected:
  SimSwitchTest() {
    ::setenv("TZ", "UTC", 1);
    folder_.write("ice_test_lte.deviceconfig", "any");
    ::setenv("VESPSCOPE_RESOURCES", folder_.path().c_str(), 1);
    rhox::client::setAddress(rhox::client::Address::parse(manager_.address()).value());
    manager_.setSource("/dev/ttyUSB0", "live");
    application::registerDelegateClass("AppDelegate", [] { return std::make_unique<AppDelegate>(); });
  }

  void run(std::optional<std::int32_t> wanted, const std::function<void(application::Application&)>& steps) {
    const auto sims = SimSwitch::create(wanted);
    sims->install();
    application::Application application{.interface = mainInterface(),
                                         .navigation = nullptr,
                                         .status = statusProvider(sims),
                                         .screenAge = screenAgeProvider(sims),
                                         .showNextSim = [&sims] { sims->showNext(); }};
    sims->onShown([&application] { application::reloadTables(application); });
    SwitchSteps frontend(steps);
    EXPECT_EQ(application::applicationMain({"vespscope"}, "AppDelegate", application, frontend), 0);
  }

  void sendCell(std::int32_t sim, std::uint32_t pci) {
    KCellularLteScellInfo message;
    message.setPhyCellId(pci);
    manager_.sendMetric(metricIdentifier("K_LTE_SCELL_INFO"), message.encoded(), sim);
  }
  void sendState(std::int32_t sim) {
    KCellularLteRrcState message;
    message.setState(LteRrcState::KLTE_RRC_STATE_IDLE);
    manager_.sendMetric(metricIdentifier("K_LTE_RRC_STATE"), message.encoded(), sim);
  }

  static std::shared_ptr<TableViewController> top(application::Application& application) {
    return std::dynamic_pointer_cast<TableViewController>(application.navigation->topViewController());
  }
  static std::shared_ptr<TableViewController> openServingCell(application::Application& application) {
    application.navigation->selectRow(application.interface, top(application), {0, 1});  // LTE
    application.navigation->selectRow(application.interface, top(application), {0, 2});  // Serving Cell Info
    return top(application);
  }
  // The value of the row "phy_cell_id"; empty without one.
  static std::string cellOn(TableViewController& screen) {
    for (const auto& section : readTable(screen).sections) {
      for (const auto& row : section.rows) {
        if (row.label == "phy_cell_id") return row.value.value_or("");
      }
    }
    return "";
  }

  TemporaryFolder folder_;
  FakeManager manager_{folder_ / "manager.socket"};
};

TEST_F(SimSwitchTest, ShowsOnlyTheValuesOfTheOtherCardAtOnce) {
  run(std::nullopt, [this](application::Application& application) {
    const auto screen = openServingCell(application);
    EXPECT_EQ(application::simText(application.status().sims), "");
    sendState(1);
    sendCell(1, 11);
    sendCell(2, 22);
    ASSERT_TRUE(runUntil([&] { return application.status().sims.others.size() == 1; }));
    ASSERT_TRUE(runUntil([&] { return cellOn(*screen) == "11"; }));
    EXPECT_EQ(application::simText(application.status().sims), "SIM 1 (also SIM 2)");
    EXPECT_TRUE(MetricValidator::shared()->myLTERRCStateDict.has_value());

    const auto reloads = screen->tableView().reloadCount();
    application.showNextSim();
    ASSERT_TRUE(runUntil([&] { return screen->tableView().reloadCount() > reloads; }));
    EXPECT_EQ(cellOn(*screen), "22");
    EXPECT_FALSE(MetricValidator::shared()->myLTERRCStateDict.has_value()) << "the other card reported none";
    EXPECT_EQ(application::simText(application.status().sims), "SIM 2 (also SIM 1)");

    // What the card that is not shown reports meanwhile is there after the next switch.
    sendCell(1, 13);
    sendCell(2, 24);
    ASSERT_TRUE(runUntil([&] { return cellOn(*screen) == "24"; }));
    application.showNextSim();
    ASSERT_TRUE(runUntil([&] { return cellOn(*screen) == "13"; }));
    EXPECT_TRUE(MetricValidator::shared()->myLTERRCStateDict.has_value());
  });
}

TEST_F(SimSwitchTest, ShowsTheWantedCardFirst) {
  run(2, [this](application::Application& application) {
    const auto screen = openServingCell(application);
    sendCell(1, 11);
    sendCell(2, 22);
    ASSERT_TRUE(runUntil([&] { return cellOn(*screen) == "22"; }));
    EXPECT_EQ(application::nextSim(application.status().sims), 1);
  });
}

TEST_F(SimSwitchTest, KeepsTheAgeOfWhatTheOtherCardReported) {
  run(std::nullopt, [this](application::Application& application) {
    const auto screen = openServingCell(application);
    sendCell(1, 11);
    sendCell(2, 22);
    ASSERT_TRUE(runUntil([&] { return application.status().sims.others.size() == 1 && cellOn(*screen) == "11"; }));
    runUntil([end = std::chrono::steady_clock::now() + std::chrono::milliseconds(300)] {
      return std::chrono::steady_clock::now() > end;
    });
    application.showNextSim();
    ASSERT_TRUE(runUntil([&] { return cellOn(*screen) == "22"; }));
    const auto age = application.screenAge(*screen);
    ASSERT_TRUE(age && age->age);
    EXPECT_GE(*age->age, std::chrono::milliseconds(300));
  });
}

}  // namespace
}  // namespace vespscope::test
