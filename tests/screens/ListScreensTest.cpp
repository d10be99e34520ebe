// The launch screen, the first-level screen and the third-level screen.
#include <gtest/gtest.h>

#include "platform/application/System.h"
#include "screens/FirstLevelViewController.h"
#include "screens/Screens.h"
#include "screens/SecondLevelViewController.h"
#include "screens/ThirdLevelViewController.h"
#include "screens/VespViewController.h"

namespace vespscope {
namespace {

using application::CellStyle;
using application::Colour;
using application::TableCell;
using testing::makeScreen;

std::shared_ptr<TableCell> cellSaying(std::optional<std::string> text) {
  auto cell = std::make_shared<TableCell>();
  cell->textLabel = application::Label{std::move(text)};
  return cell;
}

std::vector<std::string> labelsOf(application::TableViewController& screen) {
  const application::TableSnapshot table = application::readTable(screen);
  std::vector<std::string> labels;
  for (const auto& row : table.sections.at(0).rows) labels.push_back(row.label);
  return labels;
}

auto launchScreen() { return makeScreen<VespViewController>("LaunchView", CellStyle::basic); }

auto firstLevel(std::optional<std::string> launchRow) {
  auto screen = makeScreen<FirstLevelViewController>("FirstClickView", CellStyle::basic);
  screen->seguedThroughRow = std::move(launchRow);
  return screen;
}

const std::vector<std::string> launchRows = {"Device Info", "LTE", "UMTS", "GSM"};

TEST(LaunchScreen, ShowsTheSameFourRowsWhateverHasArrived) {
  const auto screen = launchScreen();
  EXPECT_EQ(screen->numberOfSections(), 1U);
  EXPECT_EQ(labelsOf(*screen), launchRows);
  MetricValidator::shared()->myLTERRCStateDict = Record{{"state", "KLTE_RRC_STATE_IDLE"}};
  EXPECT_EQ(labelsOf(*screen), launchRows);
}

TEST(LaunchScreen, SetsOnlyTheLabel) {
  const auto screen = makeScreen<VespViewController>("LaunchView", CellStyle::value);
  const auto cell = screen->cellForRow({0, 1});
  EXPECT_EQ(cell->reuseIdentifier, "LaunchView");
  EXPECT_EQ(cell->textLabel->text, "LTE");
  EXPECT_FALSE(cell->detailTextLabel->text);
  EXPECT_FALSE(cell->disclosure);
}

TEST(LaunchScreen, HandsItsRowToTheFirstLevelScreen) {
  const auto screen = launchScreen();
  const auto destination = firstLevel(std::nullopt);
  screen->prepareForSegue({screen, destination}, {screen->cellForRow({0, 1})});
  EXPECT_EQ(destination->seguedThroughRow, "LTE");
  EXPECT_EQ(destination->numberOfRows(0), 13U);
}

TEST(LaunchScreen, HandsAbsentTextAsAbsent) {
  const auto screen = launchScreen();
  const auto destination = firstLevel("LTE");
  screen->prepareForSegue({screen, destination}, {cellSaying(std::nullopt)});
  EXPECT_FALSE(destination->seguedThroughRow);
  destination->seguedThroughRow = "LTE";
  screen->prepareForSegue({screen, destination}, {std::make_shared<TableCell>()});
  EXPECT_FALSE(destination->seguedThroughRow);
}

TEST(LaunchScreen, HandsNothingWithoutACellOrToAnotherScreen) {
  const auto screen = launchScreen();
  const auto destination = firstLevel("GSM");
  screen->prepareForSegue({screen, destination}, {nullptr});
  EXPECT_EQ(destination->seguedThroughRow, "GSM");
  const auto other = testing::secondLevel("LTE", "NAS");
  screen->prepareForSegue({screen, other}, {cellSaying("UMTS")});
  EXPECT_EQ(other->seguedThroughRow, "NAS");
}

TEST(LaunchScreen, ARowBeyondTheListIsAProgrammingError) {
  const auto screen = launchScreen();
  EXPECT_DEATH((void)screen->cellForRow({0, 4}), "fatal: the launch screen has no row 4");
}

TEST(LaunchScreen, LoadsWithAnEmptyFooterAndTheSystemBackground) {
  const auto screen = launchScreen();
  EXPECT_FALSE(screen->tableView().hasEmptyFooter());
  screen->loadViewIfNeeded();
  EXPECT_TRUE(screen->tableView().hasEmptyFooter());
  EXPECT_EQ(screen->backgroundColour(), Colour::systemBackground);
}

TEST(Background, IsLeftAloneOnAPlatformOlderThanThirteen) {
  application::setPlatformVersion({12, 5, 7});
  const std::vector<std::shared_ptr<application::ViewController>> screens = {
      launchScreen(), firstLevel("LTE"), testing::secondLevel("LTE", "NAS"),
      makeScreen<ThirdLevelViewController>("ThirdClickView", CellStyle::basic)};
  for (const auto& screen : screens) {
    screen->loadViewIfNeeded();
    EXPECT_FALSE(screen->backgroundColour());
  }
}

TEST(Background, IsTheSystemsFromThirteenOn) {
  application::setPlatformVersion({13, 0, 0});
  const std::vector<std::shared_ptr<application::ViewController>> screens = {
      launchScreen(), firstLevel("LTE"), testing::secondLevel("LTE", "NAS"),
      makeScreen<ThirdLevelViewController>("ThirdClickView", CellStyle::basic)};
  for (const auto& screen : screens) {
    screen->loadViewIfNeeded();
    EXPECT_EQ(screen->backgroundColour(), Colour::systemBackground);
  }
}

TEST(FirstLevelScreen, ThroughUmtsShowsTheFifteenUmtsRowsInOrder) {
  const auto screen = firstLevel("UMTS");
  EXPECT_EQ(screen->numberOfSections(), 1U);
  EXPECT_EQ(labelsOf(*screen),
            (std::vector<std::string>{"NAS GMM", "NAS MM", "RRC State", "RRC Configuration", "Serving Cell Info",
                                      "Serving Cell Meas", "Tx Power", "Sel Resel Parameters", "EUTRA Neighbor Info",
                                      "UTRA Neighbor Info", "GSM Neighbor Info", "LTE Neighbor Cell Meas",
                                      "UMTS Neighbor Cell Meas", "GSM Neighbor Cell Meas", "Active Bearers"}));
}

TEST(FirstLevelScreen, ThroughDeviceInfoShowsThreeRows) {
  EXPECT_EQ(labelsOf(*firstLevel("Device Info")), (std::vector<std::string>{"IMSI", "IMEISV", "SIM Files"}));
}

TEST(FirstLevelScreen, HandsTheSameRowUnderItsOwnTechnology) {
  for (const char* technology : {"GSM", "LTE"}) {
    const auto screen = firstLevel(technology);
    const auto destination = makeScreen<SecondLevelViewController>("SecondClickView", CellStyle::value);
    const auto cell = screen->cellForRow({0, 2});
    ASSERT_EQ(cell->textLabel->text, "Serving Cell Info");
    screen->prepareForSegue({screen, destination}, {cell});
    EXPECT_EQ(destination->firstSelection, technology);
    EXPECT_EQ(destination->seguedThroughRow, "Serving Cell Info");
  }
}

TEST(FirstLevelScreen, HandsAbsentTextAsAbsent) {
  const auto screen = firstLevel("LTE");
  const auto destination = testing::secondLevel("GSM", "NAS MM");
  screen->prepareForSegue({screen, destination}, {cellSaying(std::nullopt)});
  EXPECT_EQ(destination->firstSelection, "LTE");
  EXPECT_FALSE(destination->seguedThroughRow);
}

TEST(FirstLevelScreen, HandsNothingWithoutACellOrToAnotherScreen) {
  const auto screen = firstLevel("LTE");
  const auto destination = testing::secondLevel("GSM", "NAS MM");
  screen->prepareForSegue({screen, destination}, {nullptr});
  EXPECT_EQ(destination->firstSelection, "GSM");
  const auto other = firstLevel("UMTS");
  screen->prepareForSegue({screen, other}, {cellSaying("NAS")});
  EXPECT_EQ(other->seguedThroughRow, "UMTS");
}

TEST(FirstLevelScreen, HoldsTheSharedDecoderAndACatalogueOfItsOwn) {
  const auto screen = firstLevel("LTE");
  EXPECT_EQ(screen->myMetricValidator, MetricValidator::shared());
  EXPECT_EQ(screen->tableViewFields, VespViewItems::shared().firstLevelViewItems);
  screen->tableViewFields["LTE"] = {"only"};
  EXPECT_EQ(labelsOf(*screen), std::vector<std::string>{"only"});
}

TEST(FirstLevelScreen, WithoutAKnownLaunchRowAskingIsAProgrammingError) {
  EXPECT_DEATH((void)firstLevel(std::nullopt)->numberOfRows(0), "fatal: a first-level screen was shown without");
  EXPECT_DEATH((void)firstLevel(std::nullopt)->cellForRow({0, 0}), "fatal: a first-level screen was shown without");
  EXPECT_DEATH((void)firstLevel("lte")->numberOfRows(0), "fatal: the catalogue has no launch row \"lte\"");
  EXPECT_DEATH((void)firstLevel("LTE")->cellForRow({0, 13}), "fatal: \"LTE\" has no row 13");
}

TEST(ThirdLevelScreen, ShowsOneUnchangedCellWhateverTheSelectionsHold) {
  const auto screen = makeScreen<ThirdLevelViewController>("ThirdClickView", CellStyle::value);
  EXPECT_FALSE(screen->firstSelection || screen->secondSelection || screen->seguedThroughRow);
  for (int round = 0; round < 2; ++round) {
    EXPECT_EQ(screen->numberOfSections(), 1U);
    EXPECT_EQ(screen->numberOfRows(0), 1U);
    const auto cell = screen->cellForRow({0, 0});
    EXPECT_EQ(cell->reuseIdentifier, "ThirdClickView");
    EXPECT_FALSE(cell->textLabel->text);
    EXPECT_FALSE(cell->detailTextLabel->text);
    screen->firstSelection = "LTE";
    screen->secondSelection = "NAS";
    screen->seguedThroughRow = "reg_status";
  }
}

TEST(Screens, AMemoryWarningChangesNothing) {
  const auto launch = launchScreen();
  launch->didReceiveMemoryWarning();
  EXPECT_EQ(labelsOf(*launch), launchRows);
  const auto third = makeScreen<ThirdLevelViewController>("ThirdClickView", CellStyle::basic);
  third->didReceiveMemoryWarning();
  EXPECT_EQ(third->numberOfRows(0), 1U);
}

}  // namespace
}  // namespace vespscope
