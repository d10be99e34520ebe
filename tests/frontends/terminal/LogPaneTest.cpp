// The log pane follows its end, scrolls, and stays within its bounds.
#include <clocale>
#include <cstdlib>

#include <gtest/gtest.h>

#include "frontends/terminal/LogPane.h"

namespace vespscope::test {
namespace {

using namespace terminal;
using namespace std::chrono_literals;

class LogPaneTest : public ::testing::Test {
 protected:
  static constexpr Size view{40, 4};

  void SetUp() override { ::setenv("TZ", "UTC", 1); }

  void log(const std::string& text, log::Channel channel = log::Channel::standardOutput) {
    mailbox.post(channel, text, std::chrono::system_clock::time_point(1'700'000'000s));
    pane.add(mailbox.take());
  }
  void logNumbers(int from, int to) {
    for (int number = from; number < to; ++number) log("line " + std::to_string(number));
  }
  std::string shown(Size size = view) {
    Grid grid(size, false);
    pane.draw(grid, 0, size.height);
    return grid.text();
  }
  void scroll(int count) { pane.scrollBy(count, view, false); }

  LogMailbox mailbox;
  LogPane pane;
};

TEST_F(LogPaneTest, ItFollowsTheEnd) {
  logNumbers(0, 6);
  EXPECT_EQ(shown(), "out line 2\nout line 3\nout line 4\nout line 5\n");
  log("more", log::Channel::systemLog);
  EXPECT_EQ(shown(), "out line 3\nout line 4\nout line 5\nsys more\n");
  EXPECT_TRUE(pane.follows());
}

TEST_F(LogPaneTest, FewLinesStandAtTheTop) {
  logNumbers(0, 2);
  EXPECT_EQ(shown(), "out line 0\nout line 1\n\n\n");
}

TEST_F(LogPaneTest, WithRoomEachLineHasItsTime) {
  log("hello");
  EXPECT_EQ(shown({60, 1}), "22:13:20 out  hello\n");
}

TEST_F(LogPaneTest, LongLinesAreWrappedWithAnIndent) {
  log("one two three four five six seven eight nine ten");
  EXPECT_EQ(shown(), "out one two three four five six seven\n      eight nine ten\n\n\n");
}

TEST_F(LogPaneTest, ScrolledBackItStaysWhereItIsWhileLinesCome) {
  logNumbers(0, 10);
  scroll(-3);
  const std::string before = "out line 3\nout line 4\nout line 5\nout line 6\n";
  EXPECT_EQ(shown(), before);
  logNumbers(10, 20);
  EXPECT_EQ(shown(), before);
  EXPECT_FALSE(pane.follows());
  EXPECT_EQ(pane.linesBelow(), 13U);
}

TEST_F(LogPaneTest, ScrolledToTheEndItFollowsAgain) {
  logNumbers(0, 10);
  scroll(-3);
  scroll(2);
  EXPECT_FALSE(pane.follows());
  scroll(1);
  EXPECT_TRUE(pane.follows());
  EXPECT_EQ(shown(), "out line 6\nout line 7\nout line 8\nout line 9\n");
}

TEST_F(LogPaneTest, ItScrollsThroughTheLinesOfALongOne) {
  log("one two three four five six seven eight nine ten");
  logNumbers(0, 4);
  scroll(-1);
  EXPECT_EQ(shown(), "      eight nine ten\nout line 0\nout line 1\nout line 2\n");
  scroll(-100);
  EXPECT_EQ(shown().substr(0, 11), "out one two");
}

TEST_F(LogPaneTest, HomeShowsTheOldestLineAndFollowTheNewest) {
  logNumbers(0, 10);
  pane.home();
  EXPECT_EQ(shown().substr(0, 11), "out line 0\n");
  pane.follow();
  EXPECT_EQ(shown(), "out line 6\nout line 7\nout line 8\nout line 9\n");
}

TEST_F(LogPaneTest, OnlyTheLastLinesAreKept) {
  logNumbers(0, 2100);
  EXPECT_EQ(pane.lineCount(), LogPane::capacity);
  pane.home();
  EXPECT_EQ(shown().substr(0, 13), "out line 100\n");
}

TEST_F(LogPaneTest, AViewWhoseLinesAreGoneShowsTheOldestOnes) {
  logNumbers(0, 10);
  pane.home();
  logNumbers(10, 2100);
  EXPECT_EQ(shown().substr(0, 13), "out line 100\n");
}

TEST_F(LogPaneTest, TheFilterAppliesToOldAndNewLinesInWhateverCase) {
  log("Received CA Status");
  log("other");
  pane.setFilter("ca status");
  log("ca STATUS again");
  log("another");
  EXPECT_EQ(shown(), "out Received CA Status\nout ca STATUS again\n\n\n");
  EXPECT_EQ(pane.listedCount(), 2U);
  EXPECT_EQ(pane.lineCount(), 4U);
  pane.setFilter("");
  EXPECT_EQ(pane.listedCount(), 4U);
}

TEST_F(LogPaneTest, TheFilterForgetsLinesThatAreNoLongerKept) {
  log("needle");
  pane.setFilter("needle");
  logNumbers(0, 2000);
  EXPECT_EQ(pane.listedCount(), 0U);
  EXPECT_EQ(shown(), "\n\n\n\n");
}

TEST_F(LogPaneTest, ALineOfAMegabyteIsDrawnAndScrolledThrough) {
  log(std::string(std::size_t{1} << 20, 'x') + " end");
  EXPECT_NE(shown().find("end"), std::string::npos);
  pane.home();
  EXPECT_EQ(shown().find("end"), std::string::npos);
  for (int count = 0; count < 6; ++count) log(std::string(std::size_t{1} << 20, 'y'));
  EXPECT_EQ(pane.lineCount(), 4U);
}

}  // namespace
}  // namespace vespscope::test
