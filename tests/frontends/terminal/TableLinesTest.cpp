// A table screen as lines: sections, headers, labels, values.
#include <gtest/gtest.h>

#include "frontends/terminal/FakeScreens.h"
#include "frontends/terminal/TableLines.h"

namespace vespscope::test {
namespace {

using namespace terminal;
using application::TableSnapshot;

// The lines as text: a header in square brackets, a row's label and value separated by a bar.
std::vector<std::string> linesOf(const TableSnapshot& table, int width, const std::string& filter = "") {
  ScreenModel model;
  model.reload(table);
  model.setFilter(filter);
  const auto join = [](const GlyphLine& glyphs) {
    std::string text;
    for (const Glyph& glyph : glyphs) text += glyph.bytes.view();
    return text;
  };
  std::vector<std::string> lines;
  for (const TableLine& line : layOutTable(model, width, false).lines) {
    if (line.kind == TableLine::Kind::blank) lines.emplace_back();
    if (line.kind == TableLine::Kind::header) lines.push_back("[" + join(line.label) + "]");
    if (line.kind == TableLine::Kind::row) lines.push_back(join(line.label) + "|" + join(line.value));
  }
  return lines;
}

using Lines = std::vector<std::string>;

TEST(TableLines, SectionsWithTitlesHaveHeadersAndABlankLineBetweenThem) {
  EXPECT_EQ(linesOf({{valueSection("PDP 1", {{"cid", "1"}}), valueSection("PDP 2", {{"cid", "2"}})}}, 40),
            (Lines{"[PDP 1]", "cid|1", "", "[PDP 2]", "cid|2"}));
}

TEST(TableLines, SectionsWithoutTitlesAreSeparatedToo) {
  EXPECT_EQ(linesOf({{valueSection({}, {{"index", "1"}}), valueSection({}, {{"index", "2"}})}}, 40),
            (Lines{"index|1", "", "index|2"}));
}

TEST(TableLines, ASectionWithoutRowsKeepsItsHeader) {
  EXPECT_EQ(linesOf({{valueSection("PDP 1", {}), valueSection({}, {}), valueSection("PDP 2", {})}}, 40),
            (Lines{"[PDP 1]", "", "[PDP 2]"}));
}

TEST(TableLines, AFilterLeavesOutSectionsWithoutRowsInIt) {
  EXPECT_EQ(linesOf({{valueSection("A", {{"x", "1"}}), valueSection("B", {{"y", "2"}})}}, 40, "y"),
            (Lines{"[B]", "y|2"}));
}

TEST(TableLines, LongValuesAreWrappedWithNothingLost) {
  EXPECT_EQ(linesOf({{valueSection({}, {{"tai_list", "[[plmn: 26201, tac: 4711], [plmn: 26201, tac: 4712]]"}})}}, 40),
            (Lines{"tai_list|[[plmn: 26201, tac: 4711],", "|[plmn: 26201, tac: 4712]]"}));
}

TEST(TableLines, LongLabelsAreWrappedAtUnderscores) {
  const Lines lines =
      linesOf({{valueSection({}, {{"mo_signalling_ac_barring_for_special_ac", "a long value of it"}})}}, 40);
  EXPECT_EQ(lines, (Lines{"mo_signalling_ac_|a long value of it", "barring_for_|", "special_ac|"}));
}

TEST(TableLines, ShortValuesLeaveTheRoomToLabels) {
  EXPECT_EQ(linesOf({{valueSection({}, {{"drx_inactivity_timer_of_the_cell", "7"}})}}, 40),
            Lines{"drx_inactivity_timer_of_the_cell|7"});
}

TEST(TableLines, ARowWithoutTextsIsOneLine) { EXPECT_EQ(linesOf({{valueSection({}, {{"", ""}})}}, 40), Lines{"|"}); }

TEST(TableLines, AWidthOfOneCellStillGivesLines) {
  EXPECT_FALSE(linesOf({{valueSection("title", {{"label", "value"}})}}, 1).empty());
}

}  // namespace
}  // namespace vespscope::test
