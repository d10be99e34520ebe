// The whole window: its keys, its touch targets, and its names for screen readers.
#include <filesystem>
#include <fstream>
#include <iterator>
#include <regex>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "frontends/quick/FakeWindow.h"

namespace vespscope::test {
namespace {

class Main : public FakeWindow, public ::testing::WithParamInterface<Fit> {
 protected:
  static void checkTargets(Hand& hand) {
    const QRectF all(QPointF(0, 0), hand.window()->size());
    for (QQuickItem* item : Hand::itemsWhere(hand.window()->contentItem(), [](QQuickItem* each) {
           return each->inherits("QQuickAbstractButton") ||
                  (Hand::isOfType(each, "TableLine") && !each->property("header").toBool());
         })) {
      const QRectF place = Hand::placeOf(item);
      if (!place.intersects(all)) continue;
      const auto name = item->property("text").toString() + item->property("label").toString();
      EXPECT_GE(place.width(), 44) << name.toStdString();
      EXPECT_GE(place.height(), 44) << name.toStdString();
      EXPECT_GE(place.left(), 0) << name.toStdString();
      EXPECT_LE(place.right(), all.right()) << name.toStdString();
    }
  }
  // No text of a page is truncated at its side or overlaps another one.
  static void checkTexts(Hand& hand) {
    for (QQuickItem* line : hand.lines(hand.page())) {
      const QRectF place = Hand::placeOf(line);
      std::vector<QRectF> texts;
      for (QQuickItem* text : Hand::itemsWhere(line, [](QQuickItem* each) { return each->inherits("QQuickText"); })) {
        EXPECT_FALSE(text->property("truncated").toBool());
        EXPECT_LE(text->property("contentWidth").toDouble(), text->width() + 1);
        EXPECT_TRUE(place.contains(Hand::placeOf(text))) << text->property("text").toString().toStdString();
        for (const QRectF& other : texts) EXPECT_FALSE(other.intersects(Hand::placeOf(text)));
        texts.push_back(Hand::placeOf(text));
      }
    }
  }
};

TEST_P(Main, EveryTargetIsLargeEnoughAndEveryTextHasItsPlace) {
  const auto& [size, scale] = GetParam();
  fake_.detail->table.sections[0].rows.push_back(
      {"a_long_label_that_names_something_rare", "ANOTHER_LONG_VALUE", false});
  fake_.detail->table.sections[0].rows.push_back({"list", std::string(400, 'w'), false});
  fake_.detail->table.sections[0].rows.push_back(
      {"words", "[[plmn: <00 f1 10>, tac: 4711], [plmn: <00 f1 10>]]", false});
  Hand hand(fake_.application, size);
  hand.main().appearance().setTextScale(scale);
  hand.settle();
  checkTargets(hand);
  checkTexts(hand);
  hand.click(hand.line("Green"));
  checkTargets(hand);
  checkTexts(hand);
  hand.key(Qt::Key_F, Qt::ControlModifier);
  checkTargets(hand);
  hand.key(Qt::Key_Escape);
  hand.click(hand.line("unit"));
  checkTargets(hand);
  hand.key(Qt::Key_L, Qt::ControlModifier);
  checkTargets(hand);
}

TEST_F(Main, ScreenReadersGetANameForEverythingThatCanBeUsed) {
  Hand hand(fake_.application, wide);
  hand.click(hand.line("Green"));
  hand.key(Qt::Key_F, Qt::ControlModifier);
  for (QQuickItem* item : Hand::itemsWhere(hand.window()->contentItem(), [](QQuickItem* each) {
         return each->inherits("QQuickAbstractButton") || Hand::isOfType(each, "TableLine") ||
                each->inherits("QQuickTextInput") || each->inherits("QQuickListView");
       })) {
    QAccessibleInterface* reader = QAccessible::queryAccessibleInterface(item);
    ASSERT_NE(reader, nullptr) << item->metaObject()->className();
    EXPECT_FALSE(reader->text(QAccessible::Name).isEmpty()) << item->metaObject()->className();
  }
}

// Text that looks like markup could otherwise be rendered, and load pictures from anywhere.
TEST_F(Main, ShowsPlainTextAlone) {
  const std::regex element("\\b(Text|TextEdit|TextArea|Label) \\{");
  const std::regex plain("textFormat: (Text|TextEdit)\\.PlainText");
  const auto count = [](const std::string& text, const std::regex& wanted) {
    return std::distance(std::sregex_iterator(text.begin(), text.end(), wanted), {});
  };
  std::ptrdiff_t all = 0;
  for (const auto& file : std::filesystem::directory_iterator(VESPSCOPE_SOURCE_DIR "/src/frontends/quick/qml")) {
    std::ifstream stream(file.path());
    const std::string text(std::istreambuf_iterator<char>(stream), {});
    EXPECT_EQ(count(text, element), count(text, plain)) << file.path();
    all += count(text, element);
  }
  EXPECT_GE(all, 15);
}

TEST_F(Main, SlashFindsRowsAndTextTypedThereStaysText) {
  Hand hand(fake_.application, phone);
  hand.type("/");
  hand.type("r?ylY/");
  const auto fields = Hand::itemsWhere(hand.page(), [](QQuickItem* item) { return item->inherits("QQuickTextInput"); });
  ASSERT_EQ(fields.size(), 1U);
  EXPECT_EQ(fields.front()->property("text").toString(), "r?ylY/");
  EXPECT_FALSE(shows(hand, "HelpPage") || shows(hand, "LogPage"));
  hand.key(Qt::Key_Escape);
  EXPECT_EQ(hand.lines(hand.page()).size(), 3U);
}

TEST_F(Main, AQuestionMarkOpensTheHelpAndClosesIt) {
  Hand hand(fake_.application, phone);
  hand.type("?");
  ASSERT_TRUE(shows(hand, "HelpPage"));
  hand.type("?");
  EXPECT_FALSE(shows(hand, "HelpPage"));
  hand.key(Qt::Key_Down);
  EXPECT_EQ(hand.list()->property("currentIndex").toInt(), 0) << "the keys are back at the screen";
}

TEST_F(Main, RReadsTheValuesAgain) {
  Hand hand(fake_.application, phone);
  hand.click(hand.line("Green"));
  fake_.detail->table.sections[0].rows[1].value = "mm";
  hand.settle();
  ASSERT_EQ(hand.line("unit")->property("value").toString(), "nm");
  hand.type("r");
  EXPECT_EQ(hand.line("unit")->property("value").toString(), "mm");
  EXPECT_TRUE(Hand::until([&] { return toast(hand) == "Values read again"; }));
}

TEST_F(Main, YCopiesTheRowAndShiftYTheScreen) {
  Hand hand(fake_.application, phone);
  hand.click(hand.line("Green"));
  hand.key(Qt::Key_Down);
  hand.type("y");
  EXPECT_EQ(clipboard(), "wavelength: 532");
  hand.type("Y");
  EXPECT_EQ(clipboard(), "Green\n\nLight 1\nwavelength: 532\nunit: nm\n\nLight 2\nwavelength: 633\nunit: nm\n");
}

TEST_F(Main, TheKeysActOnTheColumnThatTheyAreIn) {
  Hand hand(fake_.application, wide);
  hand.key(Qt::Key_Down);
  ASSERT_EQ(hand.depth(), 2);
  hand.type("y");
  EXPECT_EQ(clipboard(), "Red");
  hand.type("/");
  EXPECT_TRUE(hand.pages()[0]->property("filtering").toBool());
  EXPECT_FALSE(hand.pages()[1]->property("filtering").toBool());
}

TEST_F(Main, LOpensTheLogAndClosesIt) {
  Hand hand(fake_.application, phone);
  hand.type("l");
  EXPECT_TRUE(shows(hand, "LogPage"));
  hand.type("l");
  EXPECT_FALSE(shows(hand, "LogPage"));
}

INSTANTIATE_TEST_SUITE_P(Sizes, Main, fits, nameOfFit);

}  // namespace
}  // namespace vespscope::test
