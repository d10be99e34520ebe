// Playing recorded events: when each is due, in its own timing or another, and the thread that plays them.
#include <atomic>
#include <chrono>
#include <cmath>
#include <condition_variable>
#include <memory>
#include <mutex>
#include <optional>
#include <stop_token>
#include <string>
#include <thread>
#include <tuple>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "platform/log/Log.h"
#include "sources/playback/Playback.h"
#include "sources/playback/Player.h"
#include "sources/playback/SourceSpec.h"
#include "support/Eventually.h"
#include "support/SimCardFilesOf.h"

namespace vespscope::sources {
namespace {

using namespace std::chrono_literals;
using std::chrono::milliseconds;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

// The moments, in ms, at which events of the given times are played; -1 for one that is left out.
std::vector<std::int64_t> momentsOf(Playback& playback, const std::vector<milliseconds>& times) {
  std::vector<std::int64_t> moments;
  for (const milliseconds time : times) {
    const auto moment = playback.schedule(time);
    moments.push_back(moment ? *moment / 1ms : -1);
  }
  return moments;
}

std::vector<std::int64_t> momentsOf(const PlaybackOptions& options, const std::vector<milliseconds>& times) {
  Playback playback(options);
  return momentsOf(playback, times);
}

TEST(Playing, KeepsTheRecordedDistances) {
  EXPECT_THAT(momentsOf({}, {5000ms, 5000ms, 5250ms, 15'250ms}), ElementsAre(0, 0, 250, 10'250));
}

TEST(Playing, AtAnotherSpeedDividesThem) {
  EXPECT_THAT(momentsOf({.speed = 10}, {0ms, 1000ms, 9000ms}), ElementsAre(0, 100, 900));
  EXPECT_THAT(momentsOf({.speed = 0.5}, {0ms, 1000ms, 9000ms}), ElementsAre(0, 2000, 18'000));
}

TEST(Playing, AsFastAsItGoesWaitsForNothing) {
  EXPECT_THAT(momentsOf({.speed = PlaybackOptions::maximum}, {0ms, 1000ms, 900'000ms}), ElementsAre(0, 0, 0));
}

TEST(Playing, ASilenceOfMoreThanTenSecondsLastsTen) {
  EXPECT_THAT(momentsOf({}, {0ms, 10'000ms, 20'001ms, 1'296'000'000ms}), ElementsAre(0, 10'000, 20'000, 30'000));
}

TEST(Playing, TimeThatRunsBackwardsIsASilenceOfTenSeconds) {
  EXPECT_THAT(momentsOf({}, {100'000ms, 99'999ms, 100'099ms, 0ms}), ElementsAre(0, 10'000, 10'100, 20'100));
}

TEST(Playing, WithRealGapsASilenceLastsAsLongAsItDidAndTimeNeverRunsBackwards) {
  EXPECT_THAT(momentsOf({.realGaps = true}, {0ms, 60'000ms, 1000ms, 3000ms}), ElementsAre(0, 60'000, 60'000, 62'000));
}

TEST(Playing, TheStartLeavesOutWhatComesBeforeAndSoDoesEachRound) {
  Playback playback({.loop = true, .start = 2s});
  EXPECT_THAT(momentsOf(playback, {0ms, 1999ms, 2500ms, 4000ms}), ElementsAre(-1, -1, 500, 2000));
  playback.restart();
  EXPECT_THAT(momentsOf(playback, {0ms, 1999ms, 2500ms}), ElementsAre(-1, -1, 3500));
}

TEST(Playing, AnotherRoundFollowsAfterASecond) {
  Playback playback({.speed = 2, .loop = true});
  EXPECT_THAT(momentsOf(playback, {1000ms, 3000ms}), ElementsAre(0, 1000));
  playback.restart();
  EXPECT_THAT(momentsOf(playback, {1000ms, 3000ms}), ElementsAre(1500, 2500));
}

// Events at given times, each with its number as payload.
class ListStream final : public EventStream {
 public:
  explicit ListStream(std::vector<milliseconds> times, bool canRewind = true)
      : times_(std::move(times)), canRewind_(canRewind) {}
  [[nodiscard]] std::string label() const override { return "list"; }
  [[nodiscard]] SourceKind kind() const override { return SourceKind::recorded; }
  [[nodiscard]] std::optional<MetricEvent> next() override {
    if (next_ == times_.size()) return std::nullopt;
    const auto number = static_cast<std::uint8_t>(next_);
    return MetricEvent{1, 0, {number}, times_[next_++]};
  }
  [[nodiscard]] bool canRewind() const override { return canRewind_; }
  void rewind() override { next_ = 0; }
  [[nodiscard]] std::optional<std::string> failure() const override { return failureText; }
  [[nodiscard]] std::optional<MetricEvent> simCardFiles(std::stop_token stop) override {
    while (searchIsLong && !stop.stop_requested()) std::this_thread::sleep_for(1ms);
    return MetricEvent{2, 0, {0x42}, 0ms};
  }

  std::optional<std::string> failureText;
  std::atomic<bool> searchIsLong = false;  // until it is set back

 private:
  std::vector<milliseconds> times_;
  bool canRewind_;
  std::size_t next_ = 0;
};

class Collector final : public EventSink {
 public:
  void deliver(MetricEvent event) override {
    const std::lock_guard lock(mutex_);
    numbers_.push_back(event.payload.at(0));
  }
  std::vector<int> numbers() {
    const std::lock_guard lock(mutex_);
    return numbers_;
  }

 private:
  std::mutex mutex_;
  std::vector<int> numbers_;
};

// Time that passes only as far as the test lets it.
class TestClock final : public PlayerClock {
 public:
  struct State {
    std::mutex mutex;
    std::condition_variable changed;
    std::chrono::nanoseconds now{0};
    bool interrupted = false;

    void advanceTo(std::chrono::nanoseconds moment) {
      {
        const std::lock_guard lock(mutex);
        now = moment;
      }
      changed.notify_all();
    }
  };
  explicit TestClock(std::shared_ptr<State> state) : state_(std::move(state)) {}

  void begin() override {}
  bool waitUntil(std::chrono::nanoseconds moment) override {
    std::unique_lock lock(state_->mutex);
    state_->changed.wait(lock, [&] { return state_->interrupted || state_->now >= moment; });
    return !state_->interrupted;
  }
  void interrupt() override {
    {
      const std::lock_guard lock(state_->mutex);
      state_->interrupted = true;
    }
    state_->changed.notify_all();
  }

 private:
  std::shared_ptr<State> state_;
};

TEST(APlayer, DeliversEachEventWhenItIsDue) {
  const auto clock = std::make_shared<TestClock::State>();
  Collector collector;
  Player player(std::make_unique<ListStream>(std::vector{0ms, 100ms, 250ms}), {}, std::make_unique<TestClock>(clock));
  player.start(collector);
  EXPECT_TRUE(test::eventually([&] { return collector.numbers().size() == 1; }));
  clock->advanceTo(99ms);
  clock->advanceTo(100ms);
  EXPECT_TRUE(test::eventually([&] { return collector.numbers().size() == 2; }));
  clock->advanceTo(249ms);
  EXPECT_THAT(collector.numbers(), ElementsAre(0, 1));
  clock->advanceTo(250ms);
  EXPECT_TRUE(test::eventually([&] { return collector.numbers().size() == 3; }));
  player.stop();
  EXPECT_THAT(collector.numbers(), ElementsAre(0, 1, 2));
}

TEST(APlayer, TellsTheStreamsLabelKindAndSimCardFiles) {
  Player player(std::make_unique<ListStream>(std::vector{0ms}), {});
  EXPECT_EQ(player.label(), "list");
  EXPECT_EQ(player.kind(), SourceKind::recorded);
  EXPECT_EQ(test::simCardFilesOf(player)->payload, Bytes{0x42});
}

TEST(APlayer, PlaysOnWhileItsStreamIsSearchedForSimCardFiles) {
  auto owned = std::make_unique<ListStream>(std::vector{0ms, 1ms});
  ListStream& stream = *owned;
  stream.searchIsLong = true;
  Player player(std::move(owned), {.speed = 10'000, .loop = true});
  std::atomic<int> found = 0;
  for (int query = 0; query < 3; ++query) player.findSimCardFiles([&](const auto&) { ++found; });
  Collector collector;
  player.start(collector);
  EXPECT_TRUE(test::eventually([&] { return collector.numbers().size() > 5; }));
  EXPECT_EQ(found, 0);
  stream.searchIsLong = false;
  EXPECT_TRUE(test::eventually([&] { return found == 3; }));
  EXPECT_EQ(test::simCardFilesOf(player)->payload, Bytes{0x42});
  player.stop();
}

TEST(APlayer, StopsASearchAndTellsNobodyWhatItFound) {
  auto owned = std::make_unique<ListStream>(std::vector{0ms});
  owned->searchIsLong = true;
  Player player(std::move(owned), {});
  std::atomic<int> found = 0;
  player.findSimCardFiles([&](const auto&) { ++found; });
  player.stop();
  EXPECT_EQ(found, 0);
}

TEST(ThePlayersClock, GoesOnFromALongDelayInsteadOfMakingUpForIt) {
  SteadyPlayerClock clock;
  clock.begin();
  std::this_thread::sleep_for(200ms);
  const auto begin = std::chrono::steady_clock::now();
  EXPECT_TRUE(clock.waitUntil(0ms));  // 200 ms late, of which 20 ms count
  EXPECT_TRUE(clock.waitUntil(100ms));
  EXPECT_GE(std::chrono::steady_clock::now() - begin, 79ms);
}

TEST(ThePlayersClock, MakesUpForAShortDelay) {
  EXPECT_EQ(SteadyPlayerClock::notMadeUpFor(-5ms), 0ms);
  EXPECT_EQ(SteadyPlayerClock::notMadeUpFor(20ms), 0ms);
  EXPECT_EQ(SteadyPlayerClock::notMadeUpFor(21ms), 1ms);
}

TEST(APlayer, StopsPromptlyWhileItWaits) {
  Collector collector;
  const auto begin = std::chrono::steady_clock::now();
  {
    Player player(std::make_unique<ListStream>(std::vector{0ms, 9000ms}), {});
    player.start(collector);
    EXPECT_TRUE(test::eventually([&] { return collector.numbers().size() == 1; }));
  }
  EXPECT_LT(std::chrono::steady_clock::now() - begin, 2s);
}

TEST(APlayer, StopsPromptlyWhileItPlaysAsFastAsItGoes) {
  Collector collector;
  Player player(std::make_unique<ListStream>(std::vector{0ms, 1ms}), {.speed = PlaybackOptions::maximum, .loop = true});
  player.start(collector);
  EXPECT_TRUE(test::eventually([&] { return collector.numbers().size() > 5; }));
  player.stop();
  const std::size_t count = collector.numbers().size();
  std::this_thread::yield();
  EXPECT_EQ(collector.numbers().size(), count);
}

TEST(APlayer, MayBeStoppedBeforeItStartedAndTwice) {
  Player player(std::make_unique<ListStream>(std::vector{0ms}), {});
  player.stop();
  player.stop();
}

TEST(APlayer, PlaysRoundAfterRound) {
  Collector collector;
  Player player(std::make_unique<ListStream>(std::vector{0ms, 1ms}), {.speed = 10'000, .loop = true});
  player.start(collector);
  EXPECT_TRUE(test::eventually([&] { return collector.numbers().size() >= 6; }));
  player.stop();
  const std::vector<int> numbers = collector.numbers();
  EXPECT_THAT(std::vector<int>(numbers.begin(), numbers.begin() + 6), ElementsAre(0, 1, 0, 1, 0, 1));
}

// What was played, and when; a clock on which any moment comes at once.
struct Played {
  std::vector<std::pair<int, std::chrono::nanoseconds>> events;
  std::chrono::nanoseconds now{0};
  std::atomic<std::size_t> count = 0;
  std::atomic<bool> full = false;
};

class InstantClock final : public PlayerClock {
 public:
  explicit InstantClock(Played& played) : played_(played) {}
  void begin() override {}
  bool waitUntil(std::chrono::nanoseconds moment) override {
    played_.now = moment;
    return !played_.full;
  }
  void interrupt() override { played_.full = true; }

 private:
  Played& played_;
};

class PlayedSink final : public EventSink {
 public:
  PlayedSink(Played& played, std::size_t limit) : played_(played), limit_(limit) {}
  void deliver(MetricEvent event) override {
    played_.events.emplace_back(event.payload.at(0), played_.now);
    if (++played_.count == limit_) played_.full = true;
  }

 private:
  Played& played_;
  std::size_t limit_;
};

using Options = std::tuple<double, bool, std::chrono::nanoseconds, bool>;  // speed, loop, start, real gaps
class APlayerWith : public testing::TestWithParam<Options> {};

TEST_P(APlayerWith, TheseOptionsPlaysWhatTheyMeanWhenTheyMeanIt) {
  const auto [speed, loop, start, realGaps] = GetParam();
  constexpr std::size_t rounds = 3;
  // A silence of half a minute, and time that runs backwards by ten seconds.
  const std::vector<milliseconds> times = {5000ms, 5500ms, 35'000ms, 25'000ms, 25'600ms};
  const std::vector<milliseconds> positions = realGaps
                                                  ? std::vector<milliseconds>{0ms, 500ms, 30'000ms, 30'000ms, 30'600ms}
                                                  : std::vector<milliseconds>{0ms, 500ms, 10'500ms, 20'500ms, 21'100ms};
  std::vector<std::pair<int, std::int64_t>> expected;  // number, moment in ms
  for (std::size_t round = 0; round < (loop ? rounds : 1); ++round) {
    const auto before = static_cast<double>(round) * static_cast<double>((positions.back() - start + 1s).count()) / 1e6;
    for (std::size_t number = 0; number < times.size(); ++number) {
      if (positions[number] < start) continue;
      const double moment =
          std::isinf(speed) ? 0 : (before + static_cast<double>((positions[number] - start).count()) / 1e6) / speed;
      expected.emplace_back(static_cast<int>(number), std::llround(moment));
    }
  }
  Played played;
  PlayedSink sink(played, loop ? expected.size() : times.size() + 1);
  Player player(std::make_unique<ListStream>(times), {speed, loop, start, realGaps},
                std::make_unique<InstantClock>(played));
  player.start(sink);
  EXPECT_TRUE(test::eventually([&] { return played.count >= expected.size(); }));
  player.stop();
  std::vector<std::pair<int, std::int64_t>> found;
  for (const auto& [number, moment] : played.events) found.emplace_back(number, std::llround(moment / 1.0ms));
  EXPECT_EQ(found, expected);
}

INSTANTIATE_TEST_SUITE_P(EachOfItsOptions, APlayerWith,
                         testing::Combine(testing::Values(1, 10, 0.5, 10'000, PlaybackOptions::maximum),
                                          testing::Bool(), testing::Values(0ns, 300ms, 500ms, 15s, 31s),
                                          testing::Bool()));

TEST(APlayer, OfAnEmptyStreamOrOneThatCannotGoBackEndsThere) {
  for (const bool empty : {true, false}) {
    const auto clock = std::make_shared<TestClock::State>();
    Collector collector;
    auto stream = std::make_unique<ListStream>(empty ? std::vector<milliseconds>() : std::vector{0ms}, empty);
    Player player(std::move(stream), {.loop = true}, std::make_unique<TestClock>(clock));
    player.start(collector);
    EXPECT_TRUE(test::eventually([&] { return empty || collector.numbers().size() == 1; }));
    clock->advanceTo(24h);
    player.stop();
    EXPECT_EQ(collector.numbers().size(), empty ? 0U : 1U);
  }
}

TEST(APlayer, LogsWhyItsStreamEndedEarly) {
  log::discardOutputs();
  std::mutex mutex;
  std::vector<std::string> lines;
  const log::Observation observation([&](log::Channel, std::string_view line) {
    const std::lock_guard lock(mutex);
    lines.emplace_back(line);
  });
  auto stream = std::make_unique<ListStream>(std::vector{0ms});
  stream->failureText = "packet 2 is cut short";
  Collector collector;
  Player player(std::move(stream), {});
  player.start(collector);
  EXPECT_TRUE(test::eventually([&] {
    const std::lock_guard lock(mutex);
    return !lines.empty();
  }));
  player.stop();
  EXPECT_THAT(lines, ElementsAre("list: packet 2 is cut short"));
}

TEST(SourceWords, NameAScenarioWithItsSeed) {
  EXPECT_EQ(SourceSpec::parse("scenario")->seed, 1U);
  EXPECT_EQ(SourceSpec::parse("scenario:seed=18446744073709551615")->seed, 18446744073709551615U);
  const auto spec = SourceSpec::parse("scenario:seed=7,speed=2.5,start=90");
  ASSERT_TRUE(spec.ok()) << spec.reason();
  EXPECT_EQ(spec->kind, SourceSpec::Kind::scenario);
  EXPECT_EQ(spec->seed, 7U);
  EXPECT_EQ(spec->playback.speed, 2.5);
  EXPECT_EQ(spec->playback.start, 90s);
  EXPECT_EQ(SourceSpec::parse("scenario,speed=max")->playback.speed, PlaybackOptions::maximum);
}

TEST(SourceWords, NameAFileWithItsOptions) {
  const auto spec = SourceSpec::parse("replay:/tmp/a b:c.pcap,loop,speed=10,start=1.5,gaps=real");
  ASSERT_TRUE(spec.ok()) << spec.reason();
  EXPECT_EQ(spec->kind, SourceSpec::Kind::replay);
  EXPECT_EQ(spec->file, "/tmp/a b:c.pcap");
  EXPECT_TRUE(spec->playback.loop);
  EXPECT_TRUE(spec->playback.realGaps);
  EXPECT_EQ(spec->playback.speed, 10);
  EXPECT_EQ(spec->playback.start, 1500ms);
  EXPECT_EQ(SourceSpec::parse("diag:-")->file, "-");
  EXPECT_FALSE(SourceSpec::parse("diag:x")->playback.loop);
  EXPECT_EQ(SourceSpec::parse("modemmanager")->kind, SourceSpec::Kind::modemManager);
  for (const char* port : {"/dev/ttyUSB0", "tcp:127.0.0.1:5000"}) {
    const auto live = SourceSpec::parse(std::string("diag:") + port);
    ASSERT_TRUE(live) << port;
    EXPECT_EQ(live->kind, SourceSpec::Kind::diagPort);
    EXPECT_EQ(live->file, port);
    EXPECT_TRUE(live->isLive());
    EXPECT_FALSE(SourceSpec::parse(std::string("diag:") + port + ",loop"));
  }
  for (const char* file : {"-", "/dev/stdin", "/dev/fd/3", "dev/ttyUSB0", "tcp"}) {
    EXPECT_EQ(SourceSpec::parse(std::string("diag:") + file)->kind, SourceSpec::Kind::diag) << file;
  }
}

TEST(SourceWords, WriteACommaOfAFileTwice) {
  const auto spec = SourceSpec::parse("replay:a,,b,,,loop");
  ASSERT_TRUE(spec.ok()) << spec.reason();
  EXPECT_EQ(spec->file, "a,b,");
  EXPECT_TRUE(spec->playback.loop);
}

TEST(SourceWords, ThatMeanNothingAreRefusedWithAReason) {
  const std::vector<std::pair<std::string, std::string>> table = {
      {"", "a source is scenario[:seed=N], replay:FILE, diag:FILE, diag:PORT or modemmanager"},
      {"radio", "a source is scenario[:seed=N], replay:FILE, diag:FILE, diag:PORT or modemmanager"},
      {"Scenario", "a source is scenario[:seed=N], replay:FILE, diag:FILE, diag:PORT or modemmanager"},
      {"replay", "it names no file"},
      {"replay:", "it names no file"},
      {"replay,loop", "it names no file"},
      {"diag:,loop", "it names no file"},
      {"scenario:", "there is no option \"\""},
      {"scenario:seed=", "seed is a whole number, not negative"},
      {"scenario:seed=-1", "seed is a whole number, not negative"},
      {"scenario:seed=1x", "seed is a whole number, not negative"},
      {"scenario:seed=1,seed=2", "seed is given twice"},
      {"scenario,loop", "there is no option \"loop\""},
      {"scenario,gaps=real", "there is no option \"gaps=real\""},
      {"replay:f,seed=1", "there is no option \"seed=1\" (a comma in a file's name is written twice)"},
      {"replay:f,loop=1", "there is no option \"loop=1\" (a comma in a file's name is written twice)"},
      {"replay:f,speed=0", "speed is a number from 0.01 to 10000, or max"},
      {"replay:f,speed=-1", "speed is a number from 0.01 to 10000, or max"},
      {"replay:f,speed=nan", "speed is a number from 0.01 to 10000, or max"},
      {"replay:f,speed=inf", "speed is a number from 0.01 to 10000, or max"},
      {"replay:f,speed=fast", "speed is a number from 0.01 to 10000, or max"},
      {"replay:f,start=-1", "start is a number of seconds, not negative"},
      {"replay:f,start=1e300", "start is a number of seconds, not negative"},
      {"replay:f,gaps=none", "gaps can only be real"},
      {"replay:f,loop,loop", "loop is given twice"},
      {"modemmanager,speed=2", "a live modem takes no options"},
      {"modemmanager:0", "a live modem takes no options"},
  };
  for (const auto& [words, reason] : table) {
    SCOPED_TRACE(words);
    const auto spec = SourceSpec::parse(words);
    ASSERT_FALSE(spec.ok());
    EXPECT_EQ(spec.reason(), "source \"" + words + "\": " + reason);
  }
}

TEST(ASteadyPlayerClock, IsEarlyByNoMoreThanItsTolerance) {
  SteadyPlayerClock clock;
  const auto before = std::chrono::steady_clock::now();
  clock.begin();
  for (const auto moment : {0us, 100us, 3000us, 3100us, 20000us}) {
    EXPECT_TRUE(clock.waitUntil(moment));
    EXPECT_GE(std::chrono::steady_clock::now() - before, moment - SteadyPlayerClock::tolerance);
  }
}

TEST(ASteadyPlayerClock, HeedsAnInterruptionWhetherOrNotThereIsAnythingToWaitFor) {
  SteadyPlayerClock clock;
  clock.begin();
  std::thread interrupter([&clock] { clock.interrupt(); });
  EXPECT_FALSE(clock.waitUntil(10h));
  interrupter.join();
  EXPECT_FALSE(clock.waitUntil(0s));
  EXPECT_FALSE(clock.waitUntil(10h));
}

}  // namespace
}  // namespace vespscope::sources
