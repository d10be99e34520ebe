// One line of a table: its text, and the user's actions on it.
#include <QTest>

#include <gtest/gtest.h>

#include "frontends/quick/FakeWindow.h"

namespace vespscope::test {
namespace {

class TableLine : public FakeWindow {};

TEST_F(TableLine, ALongTouchCopiesItsRow) {
  Hand hand(fake_.application, phone);
  hand.click(hand.line("Green"));
  QGuiApplication::clipboard()->clear();
  const QPoint point = Hand::placeOf(hand.line("unit")).center().toPoint();
  QTest::mousePress(hand.window(), Qt::LeftButton, Qt::NoModifier, point);
  EXPECT_TRUE(Hand::until([] { return clipboard() == "unit: nm"; }));
  QTest::mouseRelease(hand.window(), Qt::LeftButton, Qt::NoModifier, point);
  hand.settle();
  EXPECT_FALSE(hand.line("unit")->property("expanded").toBool());
}

TEST_F(TableLine, TheTextOfAnExpandedRowIsSelectedByTheMouse) {
  Hand hand(fake_.application, phone);
  hand.click(hand.line("Green"));
  hand.click(hand.line("wavelength"));
  const auto editors = Hand::itemsWhere(hand.page(), [](QQuickItem* item) { return item->inherits("QQuickTextEdit"); });
  ASSERT_EQ(editors.size(), 1U);
  const QRectF place = Hand::placeOf(editors.front());
  const QPoint begin(static_cast<int>(place.left()) + 1, static_cast<int>(place.center().y()));
  QTest::mousePress(hand.window(), Qt::LeftButton, Qt::NoModifier, begin);
  for (int step = 1; step <= 10; ++step) QTest::mouseMove(hand.window(), begin + QPoint(step * 10, 0));
  QTest::mouseRelease(hand.window(), Qt::LeftButton, Qt::NoModifier, begin + QPoint(100, 0));
  EXPECT_EQ(editors.front()->property("selectedText").toString(), "532");
  hand.key(Qt::Key_C, Qt::ControlModifier);
  EXPECT_EQ(clipboard(), "532");
}

TEST_F(TableLine, RowsGrowWithTheirText) {
  fake_.detail->table = {{valueSection({}, {{"short", "1"}, {"long", std::string(300, 'm')}})}};
  Hand hand(fake_.application, phone);
  hand.click(hand.line("Green"));
  EXPECT_GT(hand.line("long")->height(), 3 * hand.line("short")->height());
}

TEST_F(TableLine, ScreenReadersReadRowsAndOpenThem) {
  Hand hand(fake_.application, phone);
  QAccessibleInterface* row = QAccessible::queryAccessibleInterface(hand.line("Green"));
  EXPECT_EQ(row->role(), QAccessible::ListItem);
  EXPECT_EQ(row->text(QAccessible::Name), "Green");
  row->actionInterface()->doAction(QAccessibleActionInterface::pressAction());
  hand.settle();
  ASSERT_EQ(hand.title(), "Green");
  EXPECT_EQ(QAccessible::queryAccessibleInterface(hand.line("wavelength"))->text(QAccessible::Name), "wavelength, 532");
}

}  // namespace
}  // namespace vespscope::test
