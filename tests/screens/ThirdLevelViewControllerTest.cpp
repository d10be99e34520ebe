// The third-level screen, and the properties of all screens.
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

TEST(ThirdLevelViewController, ShowsOneUnchangedCellWhateverTheSelectionsHold) {
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

TEST(ThirdLevelViewControllerAndTheOthers, AMemoryWarningChangesNothing) {
  const auto launch = launchScreen();
  launch->didReceiveMemoryWarning();
  EXPECT_EQ(labelsOf(*launch), launchRows);
  const auto third = makeScreen<ThirdLevelViewController>("ThirdClickView", CellStyle::basic);
  third->didReceiveMemoryWarning();
  EXPECT_EQ(third->numberOfRows(0), 1U);
}

}  // namespace
}  // namespace vespscope::test
