// A table across reloads: changed rows, filtered rows, and copied text.
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include <gtest/gtest.h>

#include "platform/application/LiveTable.h"

namespace vespscope::test {
namespace {

using application::IndexPath;
using application::LiveTable;
using application::RowIdentity;
using application::SectionSnapshot;
using application::TableSnapshot;
using Paths = std::vector<IndexPath>;

SectionSnapshot section(std::optional<std::string> title,
                        const std::vector<std::pair<std::string, std::string>>& rows) {
  SectionSnapshot made{std::move(title), {}};
  for (const auto& [label, value] : rows) made.rows.push_back({label, value, false});
  return made;
}

TableSnapshot cells(int count) {
  TableSnapshot table;
  for (int cell = 1; cell <= count; ++cell) {
    table.sections.push_back(section("Cell " + std::to_string(cell), {{"pci", "1"}, {"rsrp", "-90"}}));
  }
  return table;
}

TEST(LiveTable, CountsNothingAsChangedWhenItIsReadFirst) {
  LiveTable table;
  table.reload({{section({}, {{"pci", "1"}})}});
  EXPECT_FALSE(table.hasChanged({0, 0}));
  EXPECT_FALSE(table.hasChanges());
}

TEST(LiveTable, CountsARowWithAnotherValueAsChangedUntilTheNextReload) {
  LiveTable table;
  table.reload({{section({}, {{"pci", "1"}, {"rsrp", "-90"}})}});
  table.reload({{section({}, {{"pci", "1"}, {"rsrp", "-91"}})}});
  EXPECT_FALSE(table.hasChanged({0, 0}));
  EXPECT_TRUE(table.hasChanged({0, 1}));
  EXPECT_TRUE(table.hasChanges());
  table.reload({{section({}, {{"pci", "1"}, {"rsrp", "-91"}})}});
  EXPECT_FALSE(table.hasChanged({0, 1}));
}

TEST(LiveTable, ForgetsChangesWhenAsked) {
  LiveTable table;
  table.reload(cells(1));
  table.reload(cells(2));
  EXPECT_TRUE(table.hasChanges());
  table.forgetChanges();
  EXPECT_FALSE(table.hasChanges());
}

TEST(LiveTable, CountsANewRowAsChangedAndRowsThatMovedNot) {
  LiveTable table;
  table.reload({{section({}, {{"pci", "1"}, {"band", "3"}})}});
  table.reload({{section({}, {{"rsrp", "-90"}, {"band", "3"}, {"pci", "1"}})}});
  EXPECT_TRUE(table.hasChanged({0, 0}));
  EXPECT_FALSE(table.hasChanged({0, 1}));
  EXPECT_FALSE(table.hasChanged({0, 2}));
}

TEST(LiveTable, ComparesRowsOfTheSameLabelInTheirOrder) {
  LiveTable table;
  table.reload({{section({}, {{"tac", "1"}, {"tac", "2"}})}});
  table.reload({{section({}, {{"tac", "1"}, {"tac", "3"}})}});
  EXPECT_FALSE(table.hasChanged({0, 0}));
  EXPECT_TRUE(table.hasChanged({0, 1}));
  table.reload({{section({}, {{"tac", "1"}, {"pci", "7"}, {"tac", "3"}, {"tac", "4"}})}});
  EXPECT_TRUE(table.hasChanged({0, 1}));
  EXPECT_FALSE(table.hasChanged({0, 2}));
  EXPECT_TRUE(table.hasChanged({0, 3}));
}

TEST(LiveTable, CountsRowsOfANewSectionAsChanged) {
  LiveTable table;
  table.reload(cells(1));
  table.reload(cells(2));
  EXPECT_FALSE(table.hasChanged({0, 0}));
  EXPECT_TRUE(table.hasChanged({1, 0}));
}

TEST(LiveTable, ListsRowsWhoseLabelOrValueContainsTheFilterInAnyCase) {
  LiveTable table;
  table.reload({{section({}, {{"nbr_rsrp", "-90"}, {"state", "RSRP_LOW"}, {"pci", "7"}, {"band", "-3"}})}});
  table.setFilter("rsrp");
  EXPECT_EQ(table.rows(), (Paths{{0, 0}, {0, 1}}));
  table.setFilter("-");
  EXPECT_EQ(table.rows(), (Paths{{0, 0}, {0, 3}}));
  table.setFilter("");
  EXPECT_EQ(table.rows().size(), 4U);
  EXPECT_EQ(table.rowCount(), 4U);
}

TEST(LiveTable, ListsTheTitlesOfTheSectionsThatHoldWhatTheFilterFinds) {
  LiveTable table;
  table.reload({{section("A", {{"x", "1"}}), section("B", {{"y", "2"}}), section("C", {})}});
  EXPECT_TRUE(table.isListed(0) && table.isListed(1) && table.isListed(2));
  table.setFilter("y");
  EXPECT_FALSE(table.isListed(0));
  EXPECT_TRUE(table.isListed(1));
  EXPECT_FALSE(table.isListed(2));
}

TEST(LiveTable, ListsAWholeSectionWhoseTitleContainsTheFilter) {
  LiveTable table;
  table.reload(cells(3));
  table.setFilter("cell 2");
  EXPECT_EQ(table.rows(), (Paths{{1, 0}, {1, 1}}));
  EXPECT_FALSE(table.isListed(0));
  EXPECT_TRUE(table.isListed(1));
}

TEST(LiveTable, AppliesTheFilterToRowsThatAReloadBrings) {
  LiveTable table;
  table.reload(cells(1));
  table.setFilter("rsrp");
  table.reload(cells(3));
  EXPECT_EQ(table.rows(), (Paths{{0, 1}, {1, 1}, {2, 1}}));
}

TEST(LiveTable, FindsARowByItsIdentityWhereverItMoved) {
  LiveTable table;
  table.reload({{section({}, {{"tac", "1"}, {"tac", "2"}})}});
  const RowIdentity second = table.identityOf({0, 1});
  EXPECT_EQ(second, (RowIdentity{0, "tac", 1}));
  table.reload({{section({}, {{"tac", "1"}, {"pci", "7"}, {"tac", "2"}})}});
  EXPECT_EQ(table.find(second), (IndexPath{0, 2}));
  EXPECT_EQ(table.find({0, "tac", 2}), std::nullopt);
  EXPECT_EQ(table.find({1, "tac", 0}), std::nullopt);
}

TEST(LiveTable, GivesTheListedRowsAsTextToCopy) {
  LiveTable table;
  table.reload(cells(2));
  EXPECT_EQ(tableText("LTE Neighbor Cell Meas", table),
            "LTE Neighbor Cell Meas\n\nCell 1\npci: 1\nrsrp: -90\n\nCell 2\npci: 1\nrsrp: -90\n");
  table.setFilter("pci");
  EXPECT_EQ(tableText("N", table), "N\n\nCell 1\npci: 1\n\nCell 2\npci: 1\n");
  EXPECT_EQ(application::rowText({"LTE", std::nullopt, true}), "LTE");
}

TEST(LiveTable, CopiesNoControlCharacters) {
  EXPECT_EQ(application::rowText({"apn", "a\nb\x1b[31m", false}), "apn: a␊b␛[31m");
}

}  // namespace
}  // namespace vespscope::test
