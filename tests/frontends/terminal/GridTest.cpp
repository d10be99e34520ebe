// What is written into a grid of character cells stays within its edges.
#include <clocale>

#include <gtest/gtest.h>

#include "frontends/terminal/FakeScreens.h"
#include "frontends/terminal/Grid.h"

namespace vespscope::test {
namespace {

using namespace terminal;

TEST(Grid, AWideCharacterThatWouldCrossTheEdgeIsLeftOut) {
  ASSERT_NE(std::setlocale(LC_CTYPE, "C.UTF-8"), nullptr);
  Grid grid({3, 1}, true);
  grid.put(0, 0, "中国");
  EXPECT_EQ(grid.text(), "中\n");
  EXPECT_EQ(grid.at(1, 0).glyph, "");
}

TEST(Grid, WritingBeyondTheEdgesIsClipped) {
  Grid grid({3, 2}, false);
  grid.put(-1, 0, "abcdef");
  grid.put(0, 5, "x");
  grid.fill(1, 1, 10, "-");
  EXPECT_EQ(grid.text(), "bcd\n --\n");
}

}  // namespace
}  // namespace vespscope::test
