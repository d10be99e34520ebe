// Scrolling keeps the selected row and its header in view.
#include <gtest/gtest.h>

#include "frontends/terminal/FakeScreens.h"
#include "frontends/terminal/TableScroll.h"

namespace vespscope::test {
namespace {

using namespace terminal;
using application::TableSnapshot;

// Sections of a header and two rows; all but the first begin with a blank line.
TableSnapshot cells(int count) {
  TableSnapshot table;
  for (int cell = 1; cell <= count; ++cell) {
    table.sections.push_back(valueSection("Cell " + std::to_string(cell), {{"pci", "1"}, {"rsrp", "-90"}}));
  }
  return table;
}

class TableScrollTest : public ::testing::Test {
 protected:
  static constexpr int height = 5;

  template <class Move>
  void with(Move move) {
    const TableLines lines = layOutTable(model, width, false);
    TableScroll scroll(model, lines, height);
    move(scroll);
  }
  int top() {
    const TableLines lines = layOutTable(model, width, false);
    return TableScroll(model, lines, height).top();
  }

  int width = 40;
  ScreenModel model;
};

TEST_F(TableScrollTest, MovingDownScrollsNoMoreThanNeeded) {
  model.reload(cells(3));  // 11 lines
  for (int step = 0; step < 2; ++step) with([](TableScroll& scroll) { scroll.down(); });
  EXPECT_EQ(model.selected(), 2U);
  EXPECT_EQ(top(), 1);  // lines 1 to 5; the row is line 5
}

TEST_F(TableScrollTest, MovingUpShowsTheHeaderOfASection) {
  model.reload(cells(3));
  with([](TableScroll& scroll) { scroll.end(); });
  EXPECT_EQ(top(), 6);
  with([](TableScroll& scroll) { scroll.up(); });
  EXPECT_EQ(top(), 6);
  with([](TableScroll& scroll) { scroll.up(); });
  with([](TableScroll& scroll) { scroll.up(); });
  EXPECT_EQ(model.selected(), 2U);
  EXPECT_EQ(top(), 3);  // the blank line and header before row 2, the first of its section
  with([](TableScroll& scroll) { scroll.home(); });
  EXPECT_EQ(top(), 0);
}

TEST_F(TableScrollTest, TheViewNeverGoesBeyondTheEnds) {
  model.reload(cells(3));
  with([](TableScroll& scroll) { scroll.scrollBy(100); });
  EXPECT_EQ(top(), 6);
  with([](TableScroll& scroll) { scroll.scrollBy(-100); });
  EXPECT_EQ(top(), 0);
}

TEST_F(TableScrollTest, TheWheelTakesTheSelectionAlong) {
  model.reload(cells(3));
  with([](TableScroll& scroll) { scroll.scrollBy(3); });
  EXPECT_EQ(top(), 3);
  EXPECT_EQ(model.selected(), 2U);
  with([](TableScroll& scroll) { scroll.scrollBy(-2); });
  EXPECT_EQ(model.selected(), 2U);
  with([](TableScroll& scroll) { scroll.scrollBy(-1); });
  EXPECT_EQ(model.selected(), 1U);
}

TEST_F(TableScrollTest, PagesReachBothEnds) {
  model.reload(cells(5));  // 19 lines
  for (int step = 0; step < 5; ++step) with([](TableScroll& scroll) { scroll.pageDown(); });
  EXPECT_EQ(top(), 14);
  EXPECT_EQ(model.selected(), 9U);
  for (int step = 0; step < 5; ++step) with([](TableScroll& scroll) { scroll.pageUp(); });
  EXPECT_EQ(top(), 0);
  EXPECT_EQ(model.selected(), 0U);
}

TEST_F(TableScrollTest, ARowTallerThanTheViewIsScrolledThroughLineByLine) {
  const std::string tall(35 * 8, 'x');
  model.reload({{valueSection({}, {{"first", "1"}, {"tall", tall}, {"last", "2"}})}});
  const TableLines lines = layOutTable(model, width, false);
  const int tallEnd = lines.rows[1].end;
  ASSERT_GT(tallEnd - lines.rows[1].begin, height);
  with([](TableScroll& scroll) { scroll.down(); });
  EXPECT_EQ(model.selected(), 1U);
  EXPECT_EQ(top(), 1);
  for (int line = 1; line + height < tallEnd; ++line) {
    EXPECT_EQ(top(), line);
    with([](TableScroll& scroll) { scroll.down(); });
    EXPECT_EQ(model.selected(), 1U);
  }
  with([](TableScroll& scroll) { scroll.down(); });
  EXPECT_EQ(model.selected(), 2U);
  for (int step = 0; step < 20; ++step) with([](TableScroll& scroll) { scroll.up(); });
  EXPECT_EQ(model.selected(), 0U);
  EXPECT_EQ(top(), 0);
}

TEST_F(TableScrollTest, TheViewStaysAcrossAReloadThatLengthensRowsAboveIt) {
  TableSnapshot table = cells(6);
  model.reload(table);
  with([](TableScroll& scroll) { scroll.scrollBy(12); });
  const TableLines before = layOutTable(model, width, false);
  const auto shown = before.lines[static_cast<std::size_t>(top())];
  table.sections[0].rows[0].value = std::string(100, 'x');
  model.reload(table);
  const TableLines after = layOutTable(model, width, false);
  ASSERT_GT(after.count(), before.count());
  const auto& line = after.lines[static_cast<std::size_t>(top())];
  EXPECT_EQ(line.kind, shown.kind);
  EXPECT_EQ(line.section, shown.section);
}

TEST_F(TableScrollTest, TheViewStaysWhenLaterSectionsGo) {
  model.reload(cells(9));
  with([](TableScroll& scroll) { scroll.scrollBy(4); });
  model.reload(cells(5));
  EXPECT_EQ(top(), 4);
}

TEST_F(TableScrollTest, WhenTheSectionInViewIsGoneTheEndIsShown) {
  model.reload(cells(9));
  with([](TableScroll& scroll) { scroll.end(); });
  model.reload(cells(3));
  with([](TableScroll& scroll) { scroll.settle(); });
  EXPECT_EQ(top(), 6);
  EXPECT_EQ(model.selected(), 5U);
}

TEST_F(TableScrollTest, AnEmptyTableMayBeMovedAboutIn) {
  model.reload({});
  with([](TableScroll& scroll) {
    scroll.down();
    scroll.up();
    scroll.pageDown();
    scroll.pageUp();
    scroll.home();
    scroll.end();
    scroll.scrollBy(3);
    scroll.settle();
    EXPECT_EQ(scroll.top(), 0);
  });
}

}  // namespace
}  // namespace vespscope::test
