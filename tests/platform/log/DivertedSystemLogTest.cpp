// Lines for the system log that go to the code that asked for the work instead.
#include <string>
#include <string_view>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "platform/log/DivertedSystemLog.h"
#include "platform/log/Log.h"

namespace vespscope::test {
namespace {

using log::DivertedSystemLog;
using Lines = std::vector<std::string>;

class DivertedSystemLogTest : public testing::Test {
 protected:
  DivertedSystemLogTest() { log::discardOutputs(); }
  ~DivertedSystemLogTest() override { log::discardOutputs(false); }

  Lines logged_;
  Lines given_;
  const DivertedSystemLog::Lines take_ = [this](std::string_view line) { given_.emplace_back(line); };
  const DivertedSystemLog::Lines nothing_;

 private:
  const log::Observation observation_{[this](log::Channel channel, std::string_view line) {
    logged_.emplace_back((channel == log::Channel::systemLog ? "system: " : "output: ") + std::string(line));
  }};
};

TEST_F(DivertedSystemLogTest, GoToTheFunctionUntilItEnds) {
  {
    const DivertedSystemLog diverted(take_);
    log::system("one");
    log::print("two");
  }
  log::system("three");
  EXPECT_EQ(given_, Lines{"one"});
  EXPECT_EQ(logged_, (Lines{"output: two", "system: three"}));
}

TEST_F(DivertedSystemLogTest, AreLostWithoutAFunction) {
  const DivertedSystemLog diverted(nothing_);
  log::system("one");
  EXPECT_EQ(logged_, Lines{});
}

TEST_F(DivertedSystemLogTest, GoToTheInnermostOfSeveral) {
  const DivertedSystemLog outer(take_);
  {
    const DivertedSystemLog inner(nothing_);
    log::system("one");
  }
  log::system("two");
  EXPECT_EQ(given_, Lines{"two"});
  EXPECT_EQ(logged_, Lines{});
}

TEST_F(DivertedSystemLogTest, OfOtherThreadsAreLogged) {
  const DivertedSystemLog diverted(take_);
  std::thread([] { log::system("one"); }).join();
  EXPECT_EQ(given_, Lines{});
  EXPECT_EQ(logged_, Lines{"system: one"});
}

}  // namespace
}  // namespace vespscope::test
