// The viewer's own screens as the window shows them, compared with the decoder's state.
#include <QTest>
#include <filesystem>
#include <fstream>
#include <map>
#include <sstream>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "frontends/quick/Hand.h"
#include "frontends/terminal/FakeScreens.h"
#include "metrics/MetricValidator.h"
#include "platform/dispatch/MainLoop.h"
#include "rhoxlink/Rhoxlink.h"
#include "shell/MainInterface.h"
#include "support/ScreenGrid.h"
#include "support/ScriptedRun.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;

constexpr QSize phone(360, 720);
constexpr QSize turned(720, 360);
constexpr QSize wide(1280, 800);

// The golden grids of the screens behind one launch row after the scripted run, by their names.
std::map<std::string, std::string> goldenGrids(const std::string& launchRow) {
  const auto folder = std::filesystem::path(VESPSCOPE_SOURCE_DIR) / "tests" / "screens" / "golden" / "after";
  std::ifstream file(folder / (launchRow + ".txt"));
  std::map<std::string, std::string> grids;
  std::string name;
  for (std::string line; std::getline(file, line);) {
    if (line.starts_with("== ")) {
      name = line.substr(3, line.size() - 6);
      grids[name].clear();
    } else if (!line.empty()) {
      grids[name] += line + '\n';
    }
  }
  return grids;
}

class MainWindow : public WindowTest, public ::testing::WithParamInterface<const char*> {
 protected:
  MainWindow() {
    rhox::client::setAddress({rhox::client::Address::Kind::none, {}});
    application_.interface = mainInterface();
    application_.navigation = application_.interface.instantiateInitial();
    application_.navigation->loadViewIfNeeded();
    application_.navigation->topViewController()->loadViewIfNeeded();
  }

  static void runScript() {
    for (const MetricEvent& event : scriptedRun()) {
      MetricValidator::shared()->metricsDidUpdate(std::make_shared<Record>(eventDictionary(event)));
    }
  }
  // Lets five seconds pass, so that the screens read the decoder again.
  static void letScreensReload(Hand& hand) {
    dispatch::MainLoop::main().advance(5s);
    QTest::qWait(20);
    hand.settle();
  }

  application::Application application_;
};

TEST_F(MainWindow, FromTheLaunchListToServingCellInfoAndBack) {
  runScript();
  Hand hand(application_, phone);
  EXPECT_EQ(hand.title(), "vespscope");
  EXPECT_EQ(hand.lines(hand.page()).size(), 4U);
  hand.tap(hand.line("LTE"));
  EXPECT_EQ(hand.title(), "LTE");
  hand.tap(hand.line("Serving Cell Info"));
  EXPECT_EQ(hand.title(), "Serving Cell Info");
  EXPECT_EQ(hand.line("phy_cell_id")->property("value").toString(), QStringLiteral("185"));
  hand.click(hand.button("Back"));
  EXPECT_EQ(hand.title(), "LTE");
  hand.key(Qt::Key_Escape);
  EXPECT_EQ(hand.title(), "vespscope");
}

TEST_P(MainWindow, EveryScreenShowsWhatTheDecoderHolds) {
  runScript();
  const auto grids = goldenGrids(GetParam());
  Hand hand(application_, wide);
  hand.click(hand.line(QString::fromLatin1(GetParam())));
  const application::TableSnapshot list = hand.readPageByPage();
  ASSERT_EQ(list.sections.size(), 1U);
  EXPECT_EQ(list.sections[0].rows.size(), grids.size());
  for (const application::RowSnapshot& row : list.sections[0].rows) {
    SCOPED_TRACE(row.label);
    QQuickItem* catalogue = hand.pages().at(1);
    hand.click(hand.line(catalogue, QString::fromStdString(row.label)));
    ASSERT_EQ(hand.title(), row.label);
    FakeScreen shown;
    shown.table = hand.readPageByPage();
    ASSERT_TRUE(grids.contains(row.label));
    if (shown.table.sections.empty()) {
      EXPECT_EQ(Hand::itemsOfType(hand.page(), "EmptyState").size(), 1U);
      EXPECT_THAT((std::vector<std::string>{"(no sections)\n", "(no rows)\n"}),
                  ::testing::Contains(grids.at(row.label)));
    } else {
      EXPECT_EQ(gridOf(shown), grids.at(row.label));
    }
  }
}

INSTANTIATE_TEST_SUITE_P(Technologies, MainWindow, ::testing::Values("Device Info", "LTE", "UMTS", "GSM"),
                         [](const auto& launchRow) {
                           std::string name = launchRow.param;
                           std::erase(name, ' ');
                           return name;
                         });

TEST_F(MainWindow, ATableFollowsTheDecoderAndKeepsItsPlace) {
  runScript();
  Hand hand(application_, QSize(320, 400));
  hand.click(hand.line("LTE"));
  hand.click(hand.line("Serving Cell Info"));
  hand.wheel(hand.list(), -1);
  for (int steps = 0; steps < 8; ++steps) hand.key(Qt::Key_Down);
  const int current = hand.list()->property("currentIndex").toInt();
  const double place = hand.list()->property("contentY").toDouble();
  ASSERT_GT(place, 0);
  ASSERT_EQ(current, 7);
  const auto decoder = MetricValidator::shared();
  ASSERT_TRUE(decoder->myLTESCellInfoDict);
  decoder->myLTESCellInfoDict->set("freq_band_ind", std::int64_t{4});
  letScreensReload(hand);
  EXPECT_EQ(hand.list()->property("currentIndex").toInt(), current);
  EXPECT_EQ(hand.list()->property("contentY").toDouble(), place);
  EXPECT_EQ(hand.line("freq_band_ind")->property("value").toString(), QStringLiteral("4"));
  EXPECT_TRUE(hand.line("freq_band_ind")->property("changed").toBool());
  EXPECT_FALSE(hand.line("cell_id")->property("changed").toBool());
  EXPECT_TRUE(Hand::until([&] { return !hand.line("freq_band_ind")->property("changed").toBool(); }));
}

TEST_F(MainWindow, AScreenThatWaitsForItsMetricSaysSoUntilItComes) {
  // The decoder lives as long as the process, and other tests may have filled it.
  MetricValidator::shared()->myLTESCellInfoDict.reset();
  Hand hand(application_, phone);
  hand.click(hand.line("LTE"));
  hand.click(hand.line("Serving Cell Info"));
  EXPECT_EQ(Hand::itemsOfType(hand.page(), "EmptyState").size(), 1U);
  runScript();
  letScreensReload(hand);
  EXPECT_EQ(Hand::itemsOfType(hand.page(), "EmptyState").size(), 0U);
  EXPECT_NE(hand.line("phy_cell_id"), nullptr);
}

TEST_F(MainWindow, TwoHundredNeighboursAreScrolledFromEndToEnd) {
  RecordList neighbours;
  for (std::int64_t cell = 0; cell < 200; ++cell) {
    Record neighbour;
    neighbour.set("phy_cell_id", cell);
    neighbour.set("rsrp", std::int64_t{-140} + cell / 2);
    neighbours.push_back(neighbour);
  }
  MetricValidator::shared()->myLTE.EutraNbrsMeas = neighbours;
  Hand hand(application_, phone);
  hand.click(hand.line("LTE"));
  hand.click(hand.line("LTE Neighbor Cell Meas"));
  const application::TableSnapshot shown = hand.readPageByPage();
  ASSERT_EQ(shown.sections.size(), 200U);
  for (std::size_t cell = 0; cell < shown.sections.size(); ++cell) {
    EXPECT_EQ(shown.sections[cell].title, "LTE Neighbor " + std::to_string(cell + 1));
    ASSERT_EQ(shown.sections[cell].rows.size(), 2U);
    EXPECT_EQ(shown.sections[cell].rows[0].value, std::to_string(cell));
  }
  EXPECT_TRUE(hand.list()->property("atYEnd").toBool());
  hand.key(Qt::Key_Home);
  EXPECT_NE(hand.line("LTE Neighbor 1"), nullptr);
}

TEST_F(MainWindow, TurningTheDeviceShowsTheListBesideTheValues) {
  runScript();
  Hand hand(application_, phone);
  hand.click(hand.line("LTE"));
  hand.click(hand.line("Serving Cell Info"));
  hand.resize(turned);
  ASSERT_EQ(hand.pages().size(), 2U);
  EXPECT_NE(hand.line(hand.pages()[0], "NAS"), nullptr);
  EXPECT_NE(hand.line("phy_cell_id"), nullptr);
  hand.resize(phone);
  ASSERT_EQ(hand.pages().size(), 1U);
  EXPECT_NE(hand.line("phy_cell_id"), nullptr);
}

}  // namespace
}  // namespace vespscope::test
