// The list of a table's lines across reloads.
#include <gtest/gtest.h>

#include "frontends/quick/FakeWindow.h"

namespace vespscope::test {
namespace {

class TableList : public FakeWindow {};

TEST_F(TableList, AReloadKeepsThePlaceAndTheSelectionWhenSectionsComeAndGo) {
  application::TableSnapshot many;
  for (int section = 1; section <= 60; ++section) {
    many.sections.push_back(valueSection("Light " + std::to_string(section), {{"number", std::to_string(section)}}));
  }
  fake_.detail->table = many;
  Hand hand(fake_.application, phone);
  hand.click(hand.line("Green"));
  for (int steps = 0; steps < 31; ++steps) hand.key(Qt::Key_Down);
  ASSERT_NE(hand.line("Light 31"), nullptr);
  const double place = Hand::placeOf(hand.line("Light 31")).y();
  many.sections.pop_back();
  many.sections[3].rows.push_back({"extra", "value", false});
  fake_.detail->show(many);
  hand.main().navigation().refresh();
  hand.settle();
  ASSERT_NE(hand.line("Light 31"), nullptr);
  EXPECT_NEAR(Hand::placeOf(hand.line("Light 31")).y(), place, 1);
  hand.key(Qt::Key_C, Qt::ControlModifier);
  EXPECT_EQ(clipboard(), "number: 31");
}

}  // namespace
}  // namespace vespscope::test
