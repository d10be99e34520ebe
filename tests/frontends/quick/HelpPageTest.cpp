// The help above the screens.
#include <gtest/gtest.h>

#include "frontends/quick/FakeWindow.h"

namespace vespscope::test {
namespace {

class HelpPage : public FakeWindow, public ::testing::WithParamInterface<Fit> {
 protected:
  static QQuickItem* helpOf(Hand& hand) { return Hand::itemsOfType(hand.window()->contentItem(), "HelpPage").front(); }
  static std::vector<QQuickItem*> textsOf(QQuickItem* item) {
    return Hand::itemsWhere(item, [](QQuickItem* each) { return each->inherits("QQuickText"); });
  }
};

TEST_F(HelpPage, OpensFromTheMenuAndNamesTheKeys) {
  Hand hand(fake_.application, phone);
  hand.click(hand.button("Menu"));
  ASSERT_TRUE(Hand::until([&] { return hand.button("Help") != nullptr; }));
  hand.click(hand.button("Help"));
  ASSERT_TRUE(shows(hand, "HelpPage"));
  QStringList texts;
  for (const QQuickItem* text : textsOf(helpOf(hand))) texts << text->property("text").toString();
  for (const char* key : {"/", "r", "y, long press", "Y", "l", "?"}) EXPECT_TRUE(texts.contains(key)) << key;
  hand.click(hand.button("Close the help"));
  EXPECT_FALSE(shows(hand, "HelpPage"));
}

TEST_F(HelpPage, ScrollsByKeysToItsEndAndClosesByEscape) {
  Hand hand(fake_.application, smallPhone);
  hand.type("?");
  const auto found = Hand::itemsWhere(helpOf(hand), [](QQuickItem* item) { return item->objectName() == "help"; });
  ASSERT_EQ(found.size(), 1U);
  hand.key(Qt::Key_Down);
  EXPECT_GT(found.front()->property("contentY").toDouble(), 0);
  hand.key(Qt::Key_End);
  EXPECT_TRUE(found.front()->property("atYEnd").toBool());
  hand.key(Qt::Key_Escape);
  EXPECT_FALSE(shows(hand, "HelpPage"));
}

TEST_P(HelpPage, ShowsEveryTextWhole) {
  const auto& [size, scale] = GetParam();
  Hand hand(fake_.application, size);
  hand.main().appearance().setTextScale(scale);
  hand.type("?");
  QQuickItem* help = helpOf(hand);
  for (QQuickItem* text : textsOf(help)) {
    const std::string words = text->property("text").toString().toStdString();
    EXPECT_FALSE(text->property("truncated").toBool()) << words;
    EXPECT_LE(text->property("contentWidth").toDouble(), text->width() + 1) << words;
    EXPECT_GE(Hand::placeOf(text).left(), Hand::placeOf(help).left()) << words;
    EXPECT_LE(Hand::placeOf(text).right(), Hand::placeOf(help).right()) << words;
  }
}

INSTANTIATE_TEST_SUITE_P(Sizes, HelpPage, fits, nameOfFit);

}  // namespace
}  // namespace vespscope::test
