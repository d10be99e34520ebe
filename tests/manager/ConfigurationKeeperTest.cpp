// Writing configurations on a separate thread: what is written, in which order, and when callers are answered.
#include <atomic>
#include <condition_variable>
#include <mutex>
#include <string>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "manager/ConfigurationKeeper.h"
#include "support/Eventually.h"

namespace vespscope::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

// A disk that performs one write at a time, when the test allows it.
class ConfigurationKeeper : public testing::Test {
 protected:
  using Problem = manager::ConfigurationKeeper::Problem;

  void allow(int count) {
    {
      const std::lock_guard lock(mutex_);
      allowed_ += count;
    }
    changed_.notify_all();
  }
  // The writes so far: "2:text", or "2:" for a removal.
  std::vector<std::string> written() {
    const std::lock_guard lock(mutex_);
    return written_;
  }
  // `name` and the problem are added to the answers once the application's configuration has been written.
  void keep(std::int64_t application, const std::string& text, const std::string& name) {
    keeper->keep(application, text.empty() ? std::nullopt : std::optional(Bytes(text.begin(), text.end())),
                 [this, name](const Problem& problem) { answers.push_back(name + problem.value_or("")); });
  }
  bool waitForAnswers(std::size_t count) {
    return eventually([&] {
      keeper->callDone();
      return answers.size() == count;
    });
  }

 private:
  Problem write(std::int64_t application, const std::optional<Bytes>& configuration) {
    std::unique_lock lock(mutex_);
    ++begun;
    changed_.wait(lock, [this] { return allowed_ > 0; });
    --allowed_;
    written_.push_back(std::to_string(application) + ":" +
                       (configuration ? std::string(configuration->begin(), configuration->end()) : ""));
    return application == 13 ? Problem("bad luck") : std::nullopt;
  }

  std::mutex mutex_;
  std::condition_variable changed_;
  int allowed_ = 0;
  std::vector<std::string> written_;

 protected:
  std::atomic<int> begun = 0;
  std::atomic<int> wakes = 0;
  std::vector<std::string> answers;
  std::unique_ptr<manager::ConfigurationKeeper> keeper = std::make_unique<manager::ConfigurationKeeper>(
      [this](std::int64_t application, const std::optional<Bytes>& configuration) {
        return write(application, configuration);
      },
      [this] { ++wakes; });
};

TEST_F(ConfigurationKeeper, AnswersOnTheCallersThreadOnceItIsWritten) {
  keep(2, "text", "first");
  ASSERT_TRUE(eventually([this] { return begun == 1; }));
  keeper->callDone();
  EXPECT_THAT(answers, IsEmpty());
  EXPECT_EQ(wakes, 0);
  allow(1);
  ASSERT_TRUE(eventually([this] { return wakes == 1; }));
  EXPECT_THAT(answers, IsEmpty());
  keeper->callDone();
  EXPECT_THAT(answers, ElementsAre("first"));
  EXPECT_THAT(written(), ElementsAre("2:text"));
  keeper->callDone();
  EXPECT_EQ(answers.size(), 1U);
}

TEST_F(ConfigurationKeeper, WritesTheNewestOfAnApplicationAndAnswersAllThatWaitForIt) {
  keep(2, "one", "1");
  ASSERT_TRUE(eventually([this] { return begun == 1; }));
  keep(2, "two", "2");
  keep(2, "", "3");
  keep(2, "four", "4");
  allow(2);
  ASSERT_TRUE(waitForAnswers(4));
  EXPECT_THAT(answers, ElementsAre("1", "2", "3", "4"));
  EXPECT_THAT(written(), ElementsAre("2:one", "2:four"));
}

TEST_F(ConfigurationKeeper, WritesFirstWhatWaitedFirst) {
  keep(5, "a", "");
  ASSERT_TRUE(eventually([this] { return begun == 1; }));
  keep(9, "b", "");
  keep(1, "c", "");
  keep(9, "d", "");
  keep(7, "", "");
  allow(4);
  ASSERT_TRUE(waitForAnswers(5));
  EXPECT_THAT(written(), ElementsAre("5:a", "9:d", "1:c", "7:"));
}

TEST_F(ConfigurationKeeper, ReportsWhatCouldNotBeWritten) {
  keep(13, "text", "failed: ");
  allow(1);
  ASSERT_TRUE(waitForAnswers(1));
  EXPECT_THAT(answers, ElementsAre("failed: bad luck"));
}

TEST_F(ConfigurationKeeper, WritesWhatWaitsBeforeItEnds) {
  keep(2, "one", "");
  keep(3, "two", "");
  allow(2);
  keeper.reset();
  EXPECT_THAT(written(), ElementsAre("2:one", "3:two"));
  EXPECT_THAT(answers, IsEmpty());
}

}  // namespace
}  // namespace vespscope::test
