// A button that is a drawing, and the tip that names it.
#include <QTest>

#include <gtest/gtest.h>

#include "frontends/quick/FakeWindow.h"

namespace vespscope::test {
namespace {

class IconButton : public FakeWindow {};

TEST_F(IconButton, ItsTipLeavesTheHeaderFree) {
  Hand hand(fake_.application, phone);
  for (const char* name : {"Menu", "Filter rows"}) {
    const QPoint point = Hand::placeOf(hand.button(name)).center().toPoint();
    QTest::mouseMove(hand.window(), point - QPoint(0, 1));
    QTest::mouseMove(hand.window(), point);
    std::vector<QQuickItem*> tips;
    ASSERT_TRUE(Hand::until([&] {
      tips = Hand::itemsWhere(hand.window()->contentItem(), [&](QQuickItem* item) {
        return item->inherits("QQuickPopupItem") && item->opacity() == 1;
      });
      return !tips.empty();
    })) << name;
    const QRectF place = Hand::placeOf(tips.front());
    EXPECT_FALSE(place.intersects(Hand::placeOf(header(hand)))) << name;
    EXPECT_GE(place.left(), 0) << name;
    EXPECT_LE(place.right(), phone.width()) << name;
    QTest::mouseMove(hand.window(), QPoint(100, 600));
    hand.settle();
  }
}

}  // namespace
}  // namespace vespscope::test
