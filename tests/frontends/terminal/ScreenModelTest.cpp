// The selection of a screen, which stays with its row when rows are added, removed and filtered.
#include <gtest/gtest.h>

#include "frontends/terminal/FakeScreens.h"
#include "frontends/terminal/ScreenModel.h"

namespace vespscope::test {
namespace {

using namespace terminal;
using application::TableSnapshot;

TableSnapshot cells(int count) {
  TableSnapshot table;
  for (int cell = 1; cell <= count; ++cell) {
    table.sections.push_back(valueSection("Cell " + std::to_string(cell), {{"pci", "1"}, {"rsrp", "-90"}}));
  }
  return table;
}

TEST(ScreenModel, TheFirstRowIsSelectedAtFirst) {
  ScreenModel model;
  EXPECT_EQ(model.selected(), std::nullopt);
  model.reload(cells(2));
  EXPECT_EQ(model.selected(), 0U);
}

TEST(ScreenModel, TheSelectionStaysWithItsRowWhenOthersComeBeforeIt) {
  ScreenModel model;
  model.reload({{valueSection({}, {{"pci", "1"}, {"rsrp", "-90"}})}});
  model.select(1);
  model.reload({{valueSection({}, {{"band", "3"}, {"pci", "1"}, {"rsrp", "-90"}})}});
  EXPECT_EQ(model.selected(), 2U);
}

TEST(ScreenModel, TheSelectionGoesToTheSameLabelOfTheLastSectionWhenItsOwnIsGoneAndReturnsWithIt) {
  ScreenModel model;
  model.reload(cells(4));
  model.select(7);  // "rsrp" of the fourth cell
  model.reload(cells(2));
  EXPECT_EQ(model.selected(), 3U);
  model.reload(cells(4));
  EXPECT_EQ(model.selected(), 7U);
}

TEST(ScreenModel, TheSelectionGoesToTheRowInItsPlaceWhenItsOwnIsGone) {
  ScreenModel model;
  model.reload({{valueSection({}, {{"a", "1"}, {"b", "2"}, {"c", "3"}})}});
  model.select(1);
  model.reload({{valueSection({}, {{"a", "1"}, {"c", "3"}})}});
  EXPECT_EQ(model.selected(), 1U);
  model.reload({{valueSection({}, {{"a", "1"}})}});
  EXPECT_EQ(model.selected(), 0U);
}

TEST(ScreenModel, ASelectionSurvivesAScreenThatIsEmptyForAWhile) {
  ScreenModel model;
  model.reload(cells(3));
  model.select(5);
  model.reload({});
  EXPECT_EQ(model.selected(), std::nullopt);
  model.reload(cells(3));
  EXPECT_EQ(model.selected(), 5U);
}

TEST(ScreenModel, AFilterThatHidesTheSelectedRowSelectsTheNextOneUntilItIsCleared) {
  ScreenModel model;
  model.reload({{valueSection({}, {{"a", "1"}, {"b", "2"}, {"c", "x"}, {"d", "x"}})}});
  model.select(1);
  model.setFilter("x");
  EXPECT_EQ(model.selected(), 0U);
  EXPECT_EQ(model.row(model.rows()[0]).label, "c");
  model.setFilter("");
  EXPECT_EQ(model.selected(), 1U);
}

TEST(ScreenModel, AFilterThatNothingMatchesLeavesNoSelection) {
  ScreenModel model;
  model.reload(cells(1));
  model.setFilter("nothing");
  EXPECT_EQ(model.selected(), std::nullopt);
  EXPECT_EQ(model.rowCount(), 2U);
}

}  // namespace
}  // namespace vespscope::test
