// Text as cells of a terminal: widths, truncation, ASCII forms.
#include <clocale>

#include <gtest/gtest.h>

#include "frontends/terminal/CellText.h"

namespace vespscope::test {
namespace {

using namespace terminal;

class CellText : public ::testing::Test {
 protected:
  void SetUp() override { ASSERT_NE(std::setlocale(LC_CTYPE, "C.UTF-8"), nullptr); }

  static std::string join(const GlyphLine& line) {
    std::string text;
    for (const Glyph& glyph : line) text += glyph.bytes.view();
    return text;
  }
  static std::vector<std::string> lines(std::string_view text, int first, int rest, bool utf8 = true) {
    std::vector<std::string> out;
    for (const GlyphLine& line : wrapped(glyphsOf(text, utf8), first, rest)) out.push_back(join(line));
    return out;
  }
};

using Lines = std::vector<std::string>;

TEST_F(CellText, AsciiTakesOneCellPerCharacter) { EXPECT_EQ(widthOf("Serving Cell", true), 12); }

TEST_F(CellText, WideCharactersTakeTwoCells) {
  const GlyphLine glyphs = glyphsOf("中国a", true);
  ASSERT_EQ(glyphs.size(), 3U);
  EXPECT_EQ(glyphs[0].width, 2);
  EXPECT_EQ(widthOf(glyphs), 5);
}

TEST_F(CellText, CombiningCharactersShareTheCellOfTheirBase) {
  const GlyphLine glyphs = glyphsOf("e\u0301x", true);
  ASSERT_EQ(glyphs.size(), 2U);
  EXPECT_EQ(glyphs[0].bytes.view(), "e\u0301");
  EXPECT_EQ(widthOf(glyphs), 2);
}

TEST_F(CellText, ACombiningCharacterWithoutABaseIsPlacedOnABlank) {
  const GlyphLine glyphs = glyphsOf("\u0301", true);
  ASSERT_EQ(glyphs.size(), 1U);
  EXPECT_EQ(glyphs[0].bytes.view(), " \u0301");
}

TEST_F(CellText, ACellTakesNoMoreThanFourCombiningCharacters) {
  std::string text = "a";
  for (int count = 0; count < 9; ++count) text += "\u0301";
  const GlyphLine glyphs = glyphsOf(text, true);
  ASSERT_EQ(glyphs.size(), 1U);
  EXPECT_EQ(glyphs[0].bytes.view().size(), 1U + 4 * 2);
}

TEST_F(CellText, CharactersThatShowNothingAreLeftOut) {
  EXPECT_EQ(join(glyphsOf("a\u200B\u200Db\uFE0F\uFEFFc", true)), "abc");
}

TEST_F(CellText, ControlCharactersAreShownAsPictures) {
  EXPECT_EQ(join(glyphsOf("a\x1b[31m\n\x7f", true)), "a␛[31m␊␡");
}

TEST_F(CellText, BytesThatAreNotUtf8AreShownAsReplacements) { EXPECT_EQ(join(glyphsOf("a\xFFz", true)), "a\uFFFDz"); }

TEST_F(CellText, WithoutUtf8EveryOtherCharacterIsAQuestionMark) {
  EXPECT_EQ(join(glyphsOf("a中\x1b\xFFz", false)), "a???z");
}

TEST_F(CellText, AShortTextIsOneLine) { EXPECT_EQ(lines("abc", 10, 10), Lines{"abc"}); }

TEST_F(CellText, AnEmptyTextIsOneEmptyLine) { EXPECT_EQ(lines("", 10, 10), Lines{""}); }

TEST_F(CellText, LinesBreakAtBlanksWhichAreLeftOut) {
  EXPECT_EQ(lines("one two three", 8, 8), (Lines{"one two", "three"}));
}

TEST_F(CellText, ABlankJustBehindAFullLineIsLeftOut) { EXPECT_EQ(lines("four five", 4, 4), (Lines{"four", "five"})); }

TEST_F(CellText, WithoutABlankLinesBreakAfterAnUnderscore) {
  EXPECT_EQ(lines("mo_signalling_ac_barring", 14, 14), (Lines{"mo_signalling_", "ac_barring"}));
}

TEST_F(CellText, AWordLongerThanALineIsBrokenAnywhereAndNothingIsLost) {
  EXPECT_EQ(lines("abcdefghij", 4, 3), (Lines{"abcd", "efg", "hij"}));
}

TEST_F(CellText, LaterLinesHaveTheirOwnWidth) {
  EXPECT_EQ(lines("<01 02 03 04 05 06>", 9, 6), (Lines{"<01 02 03", "04 05", "06>"}));
}

TEST_F(CellText, AWideCharacterThatDoesNotFitGoesToTheNextLine) {
  EXPECT_EQ(lines("中国电信", 5, 5), (Lines{"中国", "电信"}));
}

TEST_F(CellText, BlanksAtTheStartOfATextStay) { EXPECT_EQ(lines("  ab", 4, 4), Lines{"  ab"}); }

TEST_F(CellText, ATextOfBlanksAloneEnds) { EXPECT_EQ(lines("          ", 4, 4).size(), 1U); }

TEST_F(CellText, ElisionMarksTheCutAndKeepsTheWidth) {
  EXPECT_EQ(join(elided(glyphsOf("Serving Cell", true), 8, true)), "Serving…");
  EXPECT_EQ(join(elided(glyphsOf("Serving Cell", false), 8, false)), "Servin..");
  EXPECT_EQ(join(elided(glyphsOf("Serving", true), 7, true)), "Serving");
  EXPECT_EQ(widthOf(elided(glyphsOf("中国电信", true), 4, true)), 3);
  EXPECT_EQ(join(elided(glyphsOf("abc", true), 0, true)), "");
}

TEST_F(CellText, RemovingACharacterTakesAllItsBytes) {
  std::string text = "aé中😀";
  removeLastCharacter(text);
  EXPECT_EQ(text, "aé中");
  removeLastCharacter(text);
  EXPECT_EQ(text, "aé");
  removeLastCharacter(text);
  removeLastCharacter(text);
  removeLastCharacter(text);
  EXPECT_EQ(text, "");
}

}  // namespace
}  // namespace vespscope::test
