// The first-level screen: the screens of one technology.
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

TEST(FirstLevelViewController, ThroughUmtsShowsTheFifteenUmtsRowsInOrder) {
  const auto screen = firstLevel("UMTS");
  EXPECT_EQ(screen->numberOfSections(), 1U);
  EXPECT_EQ(labelsOf(*screen),
            (std::vector<std::string>{"NAS GMM", "NAS MM", "RRC State", "RRC Configuration", "Serving Cell Info",
                                      "Serving Cell Meas", "Tx Power", "Sel Resel Parameters", "EUTRA Neighbor Info",
                                      "UTRA Neighbor Info", "GSM Neighbor Info", "LTE Neighbor Cell Meas",
                                      "UMTS Neighbor Cell Meas", "GSM Neighbor Cell Meas", "Active Bearers"}));
}

TEST(FirstLevelViewController, ThroughDeviceInfoShowsThreeRows) {
  EXPECT_EQ(labelsOf(*firstLevel("Device Info")), (std::vector<std::string>{"IMSI", "IMEISV", "SIM Files"}));
}

TEST(FirstLevelViewController, HandsTheSameRowUnderItsOwnTechnology) {
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

TEST(FirstLevelViewController, HandsAbsentTextAsAbsent) {
  const auto screen = firstLevel("LTE");
  const auto destination = secondLevel("GSM", "NAS MM");
  screen->prepareForSegue({screen, destination}, {cellSaying(std::nullopt)});
  EXPECT_EQ(destination->firstSelection, "LTE");
  EXPECT_FALSE(destination->seguedThroughRow);
}

TEST(FirstLevelViewController, HandsNothingWithoutACellOrToAnotherScreen) {
  const auto screen = firstLevel("LTE");
  const auto destination = secondLevel("GSM", "NAS MM");
  screen->prepareForSegue({screen, destination}, {nullptr});
  EXPECT_EQ(destination->firstSelection, "GSM");
  const auto other = firstLevel("UMTS");
  screen->prepareForSegue({screen, other}, {cellSaying("NAS")});
  EXPECT_EQ(other->seguedThroughRow, "UMTS");
}

TEST(FirstLevelViewController, HoldsTheSharedDecoderAndACatalogueOfItsOwn) {
  const auto screen = firstLevel("LTE");
  EXPECT_EQ(screen->myMetricValidator, MetricValidator::shared());
  EXPECT_EQ(screen->tableViewFields, VespViewItems::shared().firstLevelViewItems);
  screen->tableViewFields["LTE"] = {"only"};
  EXPECT_EQ(labelsOf(*screen), std::vector<std::string>{"only"});
}

TEST(FirstLevelViewController, WithoutAKnownLaunchRowAskingIsAProgrammingError) {
  EXPECT_DEATH((void)firstLevel(std::nullopt)->numberOfRows(0), "fatal: a first-level screen was shown without");
  EXPECT_DEATH((void)firstLevel(std::nullopt)->cellForRow({0, 0}), "fatal: a first-level screen was shown without");
  EXPECT_DEATH((void)firstLevel("lte")->numberOfRows(0), "fatal: the catalogue has no launch row \"lte\"");
  EXPECT_DEATH((void)firstLevel("LTE")->cellForRow({0, 13}), "fatal: \"LTE\" has no row 13");
}

}  // namespace
}  // namespace vespscope::test
