// The catalogue of screens: rows, order and keys.
#include <type_traits>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "screens/VespViewItems.h"

namespace vespscope::test {
namespace {

using ::testing::ElementsAre;

TEST(VespViewItems, ListsTheLaunchRowsInOrder) {
  EXPECT_THAT(VespViewItems::shared().launchViewItemNames, ElementsAre("Device Info", "LTE", "UMTS", "GSM"));
}

TEST(VespViewItems, HasOneListForEachLaunchRow) {
  const VespViewItems& items = VespViewItems::shared();
  EXPECT_EQ(items.firstLevelViewItems.size(), 4U);
  for (const std::string& launch : items.launchViewItemNames) EXPECT_TRUE(items.firstLevelViewItems.contains(launch));
}

TEST(VespViewItems, ListsTheRowsOfEachLaunchRowInOrder) {
  const auto& rows = VespViewItems::shared().firstLevelViewItems;
  EXPECT_THAT(rows.at("Device Info"), ElementsAre("IMSI", "IMEISV", "SIM Files"));
  EXPECT_THAT(rows.at("LTE"),
              ElementsAre("NAS", "RRC State", "Serving Cell Info", "Serving Cell Meas", "Tx Power",
                          "Sel Resel Parameters", "EUTRA Neighbor Info", "C-DRX", "LTE Neighbor Cell Meas",
                          "UMTS Neighbor Cell Meas", "GSM Neighbor Cell Meas", "CA Status", "Active Bearers"));
  EXPECT_THAT(
      rows.at("UMTS"),
      ElementsAre("NAS GMM", "NAS MM", "RRC State", "RRC Configuration", "Serving Cell Info", "Serving Cell Meas",
                  "Tx Power", "Sel Resel Parameters", "EUTRA Neighbor Info", "UTRA Neighbor Info", "GSM Neighbor Info",
                  "LTE Neighbor Cell Meas", "UMTS Neighbor Cell Meas", "GSM Neighbor Cell Meas", "Active Bearers"));
  EXPECT_THAT(rows.at("GSM"),
              ElementsAre("NAS GMM", "NAS MM", "Serving Cell Info", "Idle Config", "Idle Serv Cell Meas",
                          "Connected Serv Cell Meas", "GSM GPRS Config", "LTE Neighbor Cell Meas",
                          "UMTS Neighbor Cell Meas", "GSM Neighbor Cell Meas", "Active Bearers"));
}

TEST(VespViewItems, IsMadeOnceAndNeverChanged) {
  EXPECT_EQ(&VespViewItems::shared(), &VespViewItems::shared());
  static_assert(std::is_const_v<decltype(VespViewItems::launchViewItemNames)>);
  static_assert(std::is_const_v<decltype(VespViewItems::firstLevelViewItems)>);
}

TEST(VespViewItems, AKeyThatComesTwiceIsAProgrammingError) {
  EXPECT_EQ(VespViewItems::dictionaryOf({{"LTE", {"NAS"}}, {"GSM", {}}}).size(), 2U);
  EXPECT_DEATH((void)VespViewItems::dictionaryOf({{"LTE", {}}, {"LTE", {"NAS"}}}),
               "fatal: the catalogue has \"LTE\" twice");
}

}  // namespace
}  // namespace vespscope::test
