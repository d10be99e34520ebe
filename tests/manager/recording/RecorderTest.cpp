// Recording on a separate thread: no caller waits for the disk, and every lost event is counted.
#include <algorithm>
#include <condition_variable>
#include <functional>
#include <memory>
#include <mutex>
#include <string>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "manager/recording/Recorder.h"
#include "platform/log/Log.h"
#include "support/Eventually.h"

namespace vespscope::test {
namespace {

using namespace manager;
using namespace std::chrono_literals;
using testing::ElementsAre;
using testing::IsEmpty;

// A disk controlled by the test.
struct Disk {
  std::mutex mutex;
  std::condition_variable changed;
  std::vector<int> written;
  std::optional<std::string> problem;
  bool stuck = false;
  std::size_t room = 1'000'000;  // events accepted before the problem
  int attempts = 0;
  std::optional<int> refused;  // an event that is never accepted
  std::uint64_t removed = 0;   // events removed by another program since the last write

  void set(const std::function<void()>& change) {
    {
      const std::lock_guard lock(mutex);
      change();
    }
    changed.notify_all();
  }
  std::vector<int> content() {
    const std::lock_guard lock(mutex);
    return written;
  }
};

class DiskTarget final : public RecordingTarget {
 public:
  explicit DiskTarget(std::shared_ptr<Disk> disk) : disk_(std::move(disk)) {}
  RecordingOutcome write(std::span<const SharedEvent> events) override {
    std::unique_lock lock(disk_->mutex);
    ++disk_->attempts;
    disk_->changed.notify_all();
    disk_->changed.wait(lock, [this] { return !disk_->stuck; });
    RecordingOutcome outcome;
    outcome.removed = std::exchange(disk_->removed, 0);
    for (const SharedEvent& event : events) {
      if (disk_->problem && disk_->written.size() >= disk_->room) {
        outcome.problem = disk_->problem;
        return outcome;
      }
      ++outcome.taken;
      if (event->metricID == disk_->refused) {
        ++outcome.refused;
      } else {
        disk_->written.push_back(event->metricID);
      }
    }
    return outcome;
  }

 private:
  std::shared_ptr<Disk> disk_;
};

class RecorderOfEvents : public testing::Test {
 protected:
  RecorderOfEvents() { log::discardOutputs(); }

  std::unique_ptr<Recorder> recorder(Recorder::Options options = {.bounds = {}, .pause = 1ms}) {
    return std::make_unique<Recorder>(std::make_unique<DiskTarget>(disk), options);
  }
  static SharedEvent event(int number, std::size_t payload = 0) {
    return std::make_shared<const MetricEvent>(MetricEvent{number, 0, Bytes(payload), 0ns});
  }
  std::vector<std::string> lines() {
    const std::lock_guard lock(mutex);
    return lines_;
  }

  std::shared_ptr<Disk> disk = std::make_shared<Disk>();

 private:
  std::mutex mutex;
  std::vector<std::string> lines_;
  log::Observation observation{[this](log::Channel, std::string_view line) {
    const std::lock_guard lock(mutex);
    lines_.emplace_back(line);
  }};
};

TEST_F(RecorderOfEvents, KeepsTheOrderAndCounts) {
  const auto recording = recorder();
  for (int number = 0; number < 2000; ++number) recording->record(event(number));
  ASSERT_TRUE(eventually([&] { return recording->status().recorded == 2000; }));
  const std::vector<int> content = disk->content();
  ASSERT_EQ(content.size(), 2000U);
  EXPECT_TRUE(std::is_sorted(content.begin(), content.end()));
  EXPECT_EQ(recording->status().lost, 0U);
  EXPECT_EQ(recording->status().problem, "");
  EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(RecorderOfEvents, WhatWaitsIsWrittenBeforeTheEnd) {
  disk->stuck = true;
  auto recording = recorder();
  for (int number = 0; number < 1000; ++number) recording->record(event(number));
  disk->set([this] { disk->stuck = false; });
  recording.reset();
  EXPECT_EQ(disk->content().size(), 1000U);
}

TEST_F(RecorderOfEvents, ADiskThatDoesNotAnswerDelaysNobodyAndTheOldestAreLostAndCounted) {
  disk->stuck = true;
  const auto recording = recorder({.bounds = {.events = 100, .bytes = 1 << 20}, .pause = 1ms});
  recording->record(event(0));
  ASSERT_TRUE(eventually([this] {
    const std::lock_guard lock(disk->mutex);
    return disk->attempts == 1;
  }));
  // Each call returns although nothing is written.
  for (int number = 1; number <= 100'000; ++number) recording->record(event(number));
  EXPECT_EQ(recording->status().lost, 99'900U);
  EXPECT_EQ(recording->status().recorded, 0U);
  disk->set([this] { disk->stuck = false; });
  ASSERT_TRUE(eventually([&] { return recording->status().recorded == 101; }));
  const std::vector<int> content = disk->content();
  EXPECT_EQ(content[0], 0);
  EXPECT_EQ(content[1], 99'901);
  EXPECT_EQ(content[100], 100'000);
}

TEST_F(RecorderOfEvents, WaitsInBoundedMemory) {
  disk->stuck = true;
  const auto recording = recorder({.bounds = {.events = 1000, .bytes = 4096}, .pause = 1ms});
  recording->record(event(0));
  ASSERT_TRUE(eventually([this] {
    const std::lock_guard lock(disk->mutex);
    return disk->attempts == 1;
  }));
  for (int number = 0; number < 100; ++number) recording->record(event(number, 1024));
  EXPECT_EQ(recording->status().lost, 96U);
  disk->set([this] { disk->stuck = false; });
}

TEST_F(RecorderOfEvents, ReportsAFullDiskOnceAndContinuesWhenThereIsSpaceWithoutLosingWhatCouldWait) {
  disk->problem = "a.pcap: cannot be written: No space left on device";
  disk->room = 3;
  const auto recording = recorder();
  for (int number = 0; number < 10; ++number) recording->record(event(number));
  ASSERT_TRUE(eventually([this] {
    const std::lock_guard lock(disk->mutex);
    return disk->attempts > 20;
  }));
  EXPECT_EQ(recording->status().recorded, 3U);
  EXPECT_EQ(recording->status().lost, 0U);
  EXPECT_EQ(recording->status().problem, "a.pcap: cannot be written: No space left on device");
  EXPECT_THAT(lines(), ElementsAre("nothing is recorded: a.pcap: cannot be written: No space left on device"));
  disk->set([this] { disk->problem.reset(); });
  ASSERT_TRUE(eventually([&] { return recording->status().recorded == 10; }));
  EXPECT_THAT(disk->content(), ElementsAre(0, 1, 2, 3, 4, 5, 6, 7, 8, 9));
  EXPECT_EQ(recording->status().problem, "");
  ASSERT_TRUE(eventually([this] { return lines().size() == 2; }));
  EXPECT_EQ(lines()[1], "recording continues; 0 events were lost meanwhile");
}

TEST_F(RecorderOfEvents, ReportsHowManyWereLostWhileTheDiskWasFull) {
  disk->problem = "full";
  disk->room = 0;
  const auto recording = recorder({.bounds = {.events = 4, .bytes = 1 << 20}, .pause = 1ms});
  recording->record(event(0));
  ASSERT_TRUE(eventually([&] { return !recording->status().problem.empty(); }));
  for (int number = 1; number < 1000; ++number) recording->record(event(number));
  disk->set([this] { disk->problem.reset(); });
  ASSERT_TRUE(eventually([this] { return lines().size() == 2; }));
  const RecordingStatus status = recording->status();
  EXPECT_GT(status.lost, 0U);
  EXPECT_EQ(lines()[1], "recording continues; " + std::to_string(status.lost) + " events were lost meanwhile");
  ASSERT_TRUE(eventually([&] { return recording->status().recorded + recording->status().lost == 1000; }));
}

TEST_F(RecorderOfEvents, AnEventThatNoFileCanHoldIsCountedAsLost) {
  disk->refused = 2;
  const auto recording = recorder();
  for (int number = 0; number < 5; ++number) recording->record(event(number));
  ASSERT_TRUE(eventually([&] { return recording->status().recorded == 4; }));
  EXPECT_EQ(recording->status().lost, 1U);
  EXPECT_THAT(disk->content(), ElementsAre(0, 1, 3, 4));
}

TEST_F(RecorderOfEvents, EventsThatAnotherProgramRemovesAreLostAndNoLongerRecorded) {
  const auto recording = recorder();
  for (int number = 1; number <= 5; ++number) recording->record(event(number));
  ASSERT_TRUE(eventually([&] { return recording->status().recorded == 5; }));
  disk->set([this] { disk->removed = 3; });
  recording->record(event(6));
  ASSERT_TRUE(eventually([&] { return recording->status().lost == 3; }));
  EXPECT_EQ(recording->status().recorded, 3U);
}

TEST_F(RecorderOfEvents, EndsWithoutDelayWhileTheDiskIsFull) {
  disk->problem = "full";
  disk->room = 0;
  auto recording = recorder({.bounds = {}, .pause = std::chrono::hours(1)});
  recording->record(event(0));
  ASSERT_TRUE(eventually([&] { return !recording->status().problem.empty(); }));
  recording.reset();
  EXPECT_THAT(disk->content(), IsEmpty());
}

}  // namespace
}  // namespace vespscope::test
