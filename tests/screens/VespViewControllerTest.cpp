// The launch screen.
#include <gtest/gtest.h>

#include "platform/application/System.h"
#include "screens/FirstLevelViewController.h"
#include "screens/Screens.h"
#include "screens/SecondLevelViewController.h"
#include "screens/ThirdLevelViewController.h"
#include "screens/VespViewController.h"

namespace vespscope::test {
namespace {

using application::CellStyle;
using application::Colour;
using application::TableCell;

TEST(VespViewController, ShowsTheSameFourRowsWhateverHasArrived) {
  const auto screen = launchScreen();
  EXPECT_EQ(screen->numberOfSections(), 1U);
  EXPECT_EQ(labelsOf(*screen), launchRows);
  MetricValidator::shared()->myLTERRCStateDict = Record{{"state", "KLTE_RRC_STATE_IDLE"}};
  EXPECT_EQ(labelsOf(*screen), launchRows);
}

TEST(VespViewController, SetsOnlyTheLabel) {
  const auto screen = makeScreen<VespViewController>("LaunchView", CellStyle::value);
  const auto cell = screen->cellForRow({0, 1});
  EXPECT_EQ(cell->reuseIdentifier, "LaunchView");
  EXPECT_EQ(cell->textLabel->text, "LTE");
  EXPECT_FALSE(cell->detailTextLabel->text);
  EXPECT_FALSE(cell->disclosure);
}

TEST(VespViewController, HandsItsRowToTheFirstLevelScreen) {
  const auto screen = launchScreen();
  const auto destination = firstLevel(std::nullopt);
  screen->prepareForSegue({screen, destination}, {screen->cellForRow({0, 1})});
  EXPECT_EQ(destination->seguedThroughRow, "LTE");
  EXPECT_EQ(destination->numberOfRows(0), 13U);
}

TEST(VespViewController, HandsAbsentTextAsAbsent) {
  const auto screen = launchScreen();
  const auto destination = firstLevel("LTE");
  screen->prepareForSegue({screen, destination}, {cellSaying(std::nullopt)});
  EXPECT_FALSE(destination->seguedThroughRow);
  destination->seguedThroughRow = "LTE";
  screen->prepareForSegue({screen, destination}, {std::make_shared<TableCell>()});
  EXPECT_FALSE(destination->seguedThroughRow);
}

TEST(VespViewController, HandsNothingWithoutACellOrToAnotherScreen) {
  const auto screen = launchScreen();
  const auto destination = firstLevel("GSM");
  screen->prepareForSegue({screen, destination}, {nullptr});
  EXPECT_EQ(destination->seguedThroughRow, "GSM");
  const auto other = secondLevel("LTE", "NAS");
  screen->prepareForSegue({screen, other}, {cellSaying("UMTS")});
  EXPECT_EQ(other->seguedThroughRow, "NAS");
}

TEST(VespViewController, ARowBeyondTheListIsAProgrammingError) {
  const auto screen = launchScreen();
  EXPECT_DEATH((void)screen->cellForRow({0, 4}), "fatal: the launch screen has no row 4");
}

TEST(VespViewController, LoadsWithAnEmptyFooterAndTheSystemBackground) {
  const auto screen = launchScreen();
  EXPECT_FALSE(screen->tableView().hasEmptyFooter());
  screen->loadViewIfNeeded();
  EXPECT_TRUE(screen->tableView().hasEmptyFooter());
  EXPECT_EQ(screen->backgroundColour(), Colour::systemBackground);
}

}  // namespace
}  // namespace vespscope::test
