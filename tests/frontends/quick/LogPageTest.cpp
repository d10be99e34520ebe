// The log above the screens.
#include <gtest/gtest.h>

#include "frontends/quick/FakeWindow.h"
#include "platform/log/Log.h"

namespace vespscope::test {
namespace {

class LogPage : public FakeWindow {};

TEST_F(LogPage, OpensByKeyShowsLinesAndCloses) {
  Hand hand(fake_.application, phone);
  log::print("something happened");
  hand.key(Qt::Key_L, Qt::ControlModifier);
  ASSERT_EQ(Hand::itemsOfType(hand.window()->contentItem(), "LogPage").size(), 1U);
  EXPECT_EQ(hand.main().log().count(), 1);
  hand.key(Qt::Key_C, Qt::ControlModifier);
  EXPECT_TRUE(clipboard().endsWith("something happened"));
  hand.key(Qt::Key_Escape);
  EXPECT_TRUE(Hand::itemsOfType(hand.window()->contentItem(), "LogPage").empty());
  EXPECT_FALSE(hand.main().log().watched());
  hand.key(Qt::Key_Down);
  EXPECT_EQ(hand.list()->property("currentIndex").toInt(), 0) << "the keys are back at the screen";
}

}  // namespace
}  // namespace vespscope::test
