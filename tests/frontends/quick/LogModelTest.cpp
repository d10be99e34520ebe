// The latest log lines as a list model.
#include <QClipboard>
#include <QGuiApplication>
#include <string>
#include <thread>

#include <gtest/gtest.h>

#include "frontends/quick/LogModel.h"
#include "platform/log/Log.h"

namespace vespscope::test {
namespace {

class LogModel : public ::testing::Test {
 protected:
  [[nodiscard]] QString text(int row) const { return model_.data(model_.index(row), quick::LogModel::text).toString(); }

  quick::LogModel model_;
};

TEST_F(LogModel, TakesLinesOfBothChannelsInOrderWhileShown) {
  log::print("first");
  log::system("second");
  EXPECT_EQ(model_.count(), 0);
  model_.setWatched(true);
  ASSERT_EQ(model_.count(), 2);
  EXPECT_EQ(text(0), "first");
  EXPECT_EQ(text(1), "second");
  EXPECT_TRUE(model_.data(model_.index(1), quick::LogModel::isSystem).toBool());
}

TEST_F(LogModel, TakesLinesFromOtherThreads) {
  std::thread([] { log::print("from elsewhere"); }).join();
  model_.takeOver();
  ASSERT_EQ(model_.count(), 1);
  EXPECT_EQ(text(0), "from elsewhere");
}

TEST_F(LogModel, KeepsTheLatestLinesOnly) {
  for (std::size_t line = 0; line < quick::LogModel::capacity + 10; ++line) log::print("line " + std::to_string(line));
  model_.takeOver();
  ASSERT_EQ(model_.count(), static_cast<int>(quick::LogModel::capacity));
  EXPECT_EQ(text(0), "line 10");
  log::print("one more");
  model_.takeOver();
  EXPECT_EQ(model_.count(), static_cast<int>(quick::LogModel::capacity));
  EXPECT_EQ(text(0), "line 11");
  EXPECT_EQ(text(model_.count() - 1), "one more");
}

TEST_F(LogModel, CopiesItsLines) {
  log::print("a line");
  model_.takeOver();
  EXPECT_EQ(model_.copyAll(), "Copied 1 line");
  EXPECT_TRUE(QGuiApplication::clipboard()->text().endsWith(" a line"));
}

}  // namespace
}  // namespace vespscope::test
