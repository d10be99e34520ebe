// Navigation by mouse, finger and keys, on a phone and on a wide window.
#include <QTest>

#include <gtest/gtest.h>

#include "frontends/quick/FakeWindow.h"

namespace vespscope::test {
namespace {

class Pages : public FakeWindow {
 protected:
  Pages() { fake_.detail->table = {{valueSection({}, {{"wavelength", "532"}, {"unit", "nm"}})}}; }
};

TEST_F(Pages, AClickOpensAScreenAndTheBackButtonLeavesIt) {
  Hand hand(fake_.application, phone);
  EXPECT_EQ(hand.title(), "vespscope");
  hand.click(hand.line("Green"));
  EXPECT_EQ(hand.depth(), 2);
  EXPECT_EQ(hand.title(), "Green");
  EXPECT_NE(hand.line("wavelength"), nullptr);
  hand.click(hand.button("Back"));
  EXPECT_EQ(hand.depth(), 1);
  EXPECT_EQ(hand.title(), "vespscope");
  EXPECT_EQ(hand.button("Back"), nullptr);
}

TEST_F(Pages, ATapOpensAScreenAndASwipeFromTheEdgeLeavesIt) {
  Hand hand(fake_.application, phone);
  hand.tap(hand.line("Blue"));
  EXPECT_EQ(hand.title(), "Blue");
  hand.swipe({6, 300}, {250, 305});
  EXPECT_EQ(hand.depth(), 1);
}

TEST_F(Pages, AShortSwipeComesBack) {
  Hand hand(fake_.application, phone);
  hand.tap(hand.line("Blue"));
  hand.swipe({6, 300}, {80, 300});
  EXPECT_EQ(hand.depth(), 2);
  EXPECT_EQ(hand.page()->x(), 0);
}

TEST_F(Pages, ATapNearTheEdgeStillReachesItsRow) {
  Hand hand(fake_.application, phone);
  const QRectF row = Hand::placeOf(hand.line("Blue"));
  QTest::mouseClick(hand.window(), Qt::LeftButton, Qt::NoModifier, QPoint(16, static_cast<int>(row.center().y())));
  hand.settle();
  EXPECT_EQ(hand.title(), "Blue");
}

TEST_F(Pages, KeysWalkTheRowsOpenAndLeave) {
  Hand hand(fake_.application, phone);
  hand.key(Qt::Key_Down);
  hand.key(Qt::Key_Down);
  EXPECT_EQ(hand.list()->property("currentIndex").toInt(), 1);
  hand.key(Qt::Key_Return);
  EXPECT_EQ(hand.title(), "Green");
  hand.key(Qt::Key_Escape);
  EXPECT_EQ(hand.depth(), 1);
  EXPECT_EQ(hand.list()->property("currentIndex").toInt(), 1);
  hand.key(Qt::Key_End);
  hand.key(Qt::Key_Enter);
  EXPECT_EQ(hand.title(), "Blue");
  hand.key(Qt::Key_Back);
  EXPECT_EQ(hand.depth(), 1);
  hand.key(Qt::Key_Home);
  EXPECT_EQ(hand.list()->property("currentIndex").toInt(), 0);
}

TEST_F(Pages, TheFirstScreenIsNeverLeft) {
  Hand hand(fake_.application, phone);
  hand.key(Qt::Key_Escape);
  hand.swipe({6, 300}, {300, 300});
  EXPECT_EQ(hand.depth(), 1);
  EXPECT_TRUE(hand.window()->isVisible());
}

TEST_F(Pages, TwoQuickStepsBackLeaveTwoScreens) {
  fake_.detail->table = leadingRows({"Deeper"});
  Hand hand(fake_.application, phone);
  hand.click(hand.line("Red"));
  hand.click(hand.line("Deeper"));
  ASSERT_EQ(hand.depth(), 3);
  QTest::keyClick(hand.window(), Qt::Key_Escape);
  QTest::keyClick(hand.window(), Qt::Key_Escape);
  hand.settle();
  EXPECT_EQ(hand.depth(), 1);
}

TEST_F(Pages, ARowThatLeadsNowhereShowsItsTextInstead) {
  Hand hand(fake_.application, phone);
  hand.click(hand.line("Green"));
  hand.click(hand.line("unit"));
  EXPECT_EQ(hand.depth(), 2);
  EXPECT_TRUE(hand.line("unit")->property("expanded").toBool());
  hand.click(hand.button("Copy row"));
  hand.key(Qt::Key_Down);
  EXPECT_TRUE(hand.line("unit")->property("expanded").toBool());
}

TEST_F(Pages, AWideWindowShowsTheScreensSideBySide) {
  Hand hand(fake_.application, wide);
  hand.click(hand.line("Green"));
  const auto pages = hand.pages();
  ASSERT_EQ(pages.size(), 2U);
  EXPECT_EQ(pages[0]->x(), 0);
  EXPECT_EQ(pages[1]->x(), pages[0]->width());
  EXPECT_TRUE(hand.line(pages[0], "Green")->property("chosen").toBool());
  EXPECT_EQ(hand.button("Back"), nullptr);
}

TEST_F(Pages, InAWideWindowAnotherRowReplacesTheColumn) {
  Hand hand(fake_.application, wide);
  hand.click(hand.line("Green"));
  hand.click(hand.line(hand.pages()[0], "Blue"));
  EXPECT_EQ(hand.depth(), 2);
  EXPECT_EQ(hand.title(), "Blue");
  EXPECT_FALSE(hand.line(hand.pages()[0], "Green")->property("chosen").toBool());
}

TEST_F(Pages, InAWideWindowArrowsGoFromColumnToColumn) {
  Hand hand(fake_.application, wide);
  hand.key(Qt::Key_Down);
  hand.key(Qt::Key_Return);
  hand.key(Qt::Key_Left);
  hand.key(Qt::Key_Down);
  EXPECT_EQ(hand.list(hand.pages()[0])->property("currentIndex").toInt(), 1);
  EXPECT_EQ(hand.depth(), 2);
  hand.key(Qt::Key_Return);
  EXPECT_EQ(hand.title(), "Green");
}

TEST_F(Pages, TurningTheDeviceKeepsTheScreensAndWhatIsOpenOnThem) {
  Hand hand(fake_.application, phone);
  hand.click(hand.line("Green"));
  hand.click(hand.line("unit"));
  hand.resize(turned);
  EXPECT_EQ(hand.depth(), 2);
  ASSERT_EQ(hand.pages().size(), 2U);
  EXPECT_TRUE(hand.line("unit")->property("expanded").toBool());
  EXPECT_LE(Hand::placeOf(hand.page()).right(), turned.width());
  hand.resize(phone);
  ASSERT_EQ(hand.pages().size(), 1U);
  EXPECT_EQ(hand.title(), "Green");
  EXPECT_EQ(hand.page()->width(), phone.width());
  EXPECT_TRUE(hand.line("unit")->property("expanded").toBool());
}

TEST_F(Pages, TheTitleOfTheWindowNamesTheScreen) {
  Hand hand(fake_.application, phone);
  EXPECT_EQ(hand.window()->title(), "vespscope");
  hand.click(hand.line("Red"));
  EXPECT_EQ(hand.window()->title(), "Red – vespscope");
}

TEST_F(Pages, InAWideWindowMovingInAListShowsTheScreenOfEachRow) {
  Hand hand(fake_.application, wide);
  for (const char* row : {"Red", "Green", "Blue"}) {
    hand.key(Qt::Key_Down);
    EXPECT_EQ(hand.title(), row);
    ASSERT_EQ(hand.pages().size(), 2U);
    EXPECT_TRUE(hand.line(hand.pages()[0], row)->property("chosen").toBool());
    EXPECT_TRUE(hand.list(hand.pages()[0])->property("activeFocus").toBool()) << "the keys stay in the list";
  }
  hand.key(Qt::Key_Home);
  EXPECT_EQ(hand.title(), "Red");
}

TEST_F(Pages, OnAPhoneMovingInAListOpensNothing) {
  Hand hand(fake_.application, phone);
  hand.key(Qt::Key_Down);
  hand.key(Qt::Key_Down);
  EXPECT_EQ(hand.depth(), 1);
}

TEST_F(Pages, EnterOnAShownRowMovesIntoItsScreenAsItIs) {
  Hand hand(fake_.application, wide);
  hand.key(Qt::Key_Down);
  const quick::TableModel* shown = hand.main().navigation().tableAt(1);
  hand.key(Qt::Key_Return);
  EXPECT_EQ(hand.main().navigation().tableAt(1), shown);
  EXPECT_TRUE(hand.list(hand.pages()[1])->property("activeFocus").toBool());
  hand.key(Qt::Key_Down);
  EXPECT_EQ(hand.list(hand.pages()[1])->property("currentIndex").toInt(), 0);
  EXPECT_EQ(hand.depth(), 2) << "a row of values leads nowhere";
}

TEST_F(Pages, RightOpensTheRowAndLeftGoesBack) {
  Hand hand(fake_.application, phone);
  hand.key(Qt::Key_Down);
  hand.key(Qt::Key_Right);
  EXPECT_EQ(hand.title(), "Red");
  hand.key(Qt::Key_Left);
  EXPECT_EQ(hand.depth(), 1);
}

TEST_F(Pages, LeftInTheFirstColumnShowsTheListBefore) {
  fake_.detail->table = leadingRows({"Deeper"});
  Hand hand(fake_.application, turned);
  hand.click(hand.line("Red"));
  hand.key(Qt::Key_Down);
  ASSERT_EQ(hand.depth(), 3);
  EXPECT_EQ(hand.pages()[0]->property("level").toInt(), 1);
  hand.key(Qt::Key_Left);
  EXPECT_EQ(hand.depth(), 2);
  EXPECT_EQ(hand.pages()[0]->property("level").toInt(), 0);
}

}  // namespace
}  // namespace vespscope::test
