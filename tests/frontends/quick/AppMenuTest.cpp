// The menu of the window.
#include <QTest>

#include <gtest/gtest.h>

#include "frontends/quick/FakeWindow.h"

namespace vespscope::test {
namespace {

class AppMenu : public FakeWindow {
 protected:
  // Opens the menu, which is in the window's overlay, and clicks a choice.
  static void choose(Hand& hand, const QString& choice) {
    hand.click(hand.button("Menu"));
    ASSERT_TRUE(Hand::until([&] { return hand.button(choice) != nullptr; })) << choice.toStdString();
    hand.click(hand.button(choice));
  }
};

TEST_F(AppMenu, CopiesTheScreenAndChangesTheLook) {
  Hand hand(fake_.application, phone);
  choose(hand, "Copy all rows");
  EXPECT_EQ(clipboard(), "vespscope\n\nRed\nGreen\nBlue\n");
  choose(hand, "Dark");
  EXPECT_EQ(hand.main().appearance().mode(), quick::Appearance::Mode::Dark);
  choose(hand, "Light");
  EXPECT_EQ(hand.main().appearance().mode(), quick::Appearance::Mode::Light);
  choose(hand, "Follow the system");
  EXPECT_EQ(hand.main().appearance().mode(), quick::Appearance::Mode::System);
  choose(hand, "Larger text");
  EXPECT_EQ(hand.main().appearance().textScale(), 1.125);
}

TEST_F(AppMenu, SwitchesToTheOtherSimCardWhereThereIsOne) {
  int switched = 0;
  fake_.application.showNextSim = [&switched] { ++switched; };
  status_.sims = {1, {2}};
  Hand hand(fake_.application, phone);
  choose(hand, "Show SIM 2");
  EXPECT_TRUE(Hand::until([&] { return toast(hand) == "Showing SIM 2"; }));
  EXPECT_EQ(switched, 1);
}

TEST_F(AppMenu, IsNotCoveredByTheTipOfItsButton) {
  Hand hand(fake_.application, phone);
  QTest::mouseMove(hand.window(), Hand::placeOf(hand.button("Menu")).center().toPoint());
  hand.click(hand.button("Menu"));
  ASSERT_TRUE(Hand::until([&] { return hand.button("Help") != nullptr; }));
  QTest::qWait(1000);
  const auto popups = Hand::itemsWhere(hand.window()->contentItem(),
                                       [](QQuickItem* item) { return item->inherits("QQuickPopupItem"); });
  EXPECT_EQ(popups.size(), 1U) << "the menu alone";
}

}  // namespace
}  // namespace vespscope::test
