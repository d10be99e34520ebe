// The thread that plays a stream of events.
#include <algorithm>
#include <atomic>
#include <chrono>
#include <cmath>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <string_view>
#include <tuple>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "ListStream.h"
#include "TestClocks.h"
#include "platform/log/Log.h"
#include "sources/playback/Player.h"
#include "support/Eventually.h"
#include "support/SimCardFilesOf.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using sources::PlaybackOptions;
using sources::Player;
using std::chrono::milliseconds;
using testing::ElementsAre;

// The lines logged while it lives.
class LogLines {
 public:
  LogLines() { log::discardOutputs(); }
  [[nodiscard]] std::vector<std::string> taken() {
    const std::lock_guard lock(mutex_);
    return lines_;
  }

 private:
  std::mutex mutex_;
  std::vector<std::string> lines_;
  log::Observation observation_{[this](log::Channel, std::string_view line) {
    const std::lock_guard lock(mutex_);
    lines_.emplace_back(line);
  }};
};

TEST(Player, DeliversEachEventWhenItIsDue) {
  const auto clock = std::make_shared<TestClock::State>();
  Collector collector;
  Player player(std::make_unique<ListStream>(std::vector{0ms, 100ms, 250ms}), {}, std::make_unique<TestClock>(clock));
  player.start(collector);
  EXPECT_TRUE(eventually([&] { return collector.numbers().size() == 1; }));
  clock->advanceTo(99ms);
  clock->advanceTo(100ms);
  EXPECT_TRUE(eventually([&] { return collector.numbers().size() == 2; }));
  clock->advanceTo(249ms);
  EXPECT_THAT(collector.numbers(), ElementsAre(0, 1));
  clock->advanceTo(250ms);
  EXPECT_TRUE(eventually([&] { return collector.numbers().size() == 3; }));
  player.stop();
  EXPECT_THAT(collector.numbers(), ElementsAre(0, 1, 2));
}

TEST(Player, ReportsTheStreamsLabelKindAndSimCardFiles) {
  Player player(std::make_unique<ListStream>(std::vector{0ms}), {});
  EXPECT_EQ(player.label(), "list");
  EXPECT_EQ(player.kind(), SourceKind::recorded);
  EXPECT_EQ(simCardFilesOf(player)->payload, Bytes{0x42});
}

TEST(Player, PlaysOnWhileItsStreamIsSearchedForSimCardFiles) {
  auto owned = std::make_unique<ListStream>(std::vector{0ms, 1ms});
  ListStream& stream = *owned;
  stream.searchIsLong = true;
  Player player(std::move(owned), {.speed = 10'000, .loop = true});
  std::atomic<int> found = 0;
  for (int query = 0; query < 3; ++query) player.findSimCardFiles([&](const auto&) { ++found; });
  Collector collector;
  player.start(collector);
  EXPECT_TRUE(eventually([&] { return collector.numbers().size() > 5; }));
  EXPECT_EQ(found, 0);
  stream.searchIsLong = false;
  EXPECT_TRUE(eventually([&] { return found == 3; }));
  EXPECT_EQ(simCardFilesOf(player)->payload, Bytes{0x42});
  player.stop();
}

TEST(Player, StopsASearchWithoutAnsweringItsQueries) {
  auto owned = std::make_unique<ListStream>(std::vector{0ms});
  owned->searchIsLong = true;
  Player player(std::move(owned), {});
  std::atomic<int> found = 0;
  player.findSimCardFiles([&](const auto&) { ++found; });
  player.stop();
  EXPECT_EQ(found, 0);
}

TEST(Player, StopsPromptlyWhileItWaits) {
  Collector collector;
  const auto begin = std::chrono::steady_clock::now();
  {
    Player player(std::make_unique<ListStream>(std::vector{0ms, 9000ms}), {});
    player.start(collector);
    EXPECT_TRUE(eventually([&] { return collector.numbers().size() == 1; }));
  }
  EXPECT_LT(std::chrono::steady_clock::now() - begin, 2s);
}

TEST(Player, StopsPromptlyWhileItPlaysAtMaximumSpeed) {
  Collector collector;
  Player player(std::make_unique<ListStream>(std::vector{0ms, 1ms}), {.speed = PlaybackOptions::maximum, .loop = true});
  player.start(collector);
  EXPECT_TRUE(eventually([&] { return collector.numbers().size() > 5; }));
  player.stop();
  const std::size_t count = collector.numbers().size();
  std::this_thread::yield();
  EXPECT_EQ(collector.numbers().size(), count);
}

TEST(Player, CanBeStoppedBeforeItsStartAndTwice) {
  Player player(std::make_unique<ListStream>(std::vector{0ms}), {});
  player.stop();
  player.stop();
}

TEST(Player, PlaysRoundAfterRound) {
  Collector collector;
  Player player(std::make_unique<ListStream>(std::vector{0ms, 1ms}), {.speed = 10'000, .loop = true});
  player.start(collector);
  EXPECT_TRUE(eventually([&] { return collector.numbers().size() >= 6; }));
  player.stop();
  const std::vector<int> numbers = collector.numbers();
  EXPECT_THAT(std::vector<int>(numbers.begin(), numbers.begin() + 6), ElementsAre(0, 1, 0, 1, 0, 1));
}

using Options = std::tuple<double, bool, std::chrono::nanoseconds, bool>;  // speed, loop, start, real gaps
class PlayerWith : public testing::TestWithParam<Options> {};

TEST_P(PlayerWith, OptionsPlaysTheEventsThatTheyMeanAtTheMomentsThatTheyMean) {
  const auto [speed, loop, start, realGaps] = GetParam();
  constexpr std::size_t rounds = 3;
  // A gap of half a minute, and time that runs backwards by ten seconds.
  const std::vector<milliseconds> times = {5000ms, 5500ms, 35'000ms, 25'000ms, 25'600ms};
  const std::vector<milliseconds> recorded = {0ms, 500ms, 30'000ms, 30'000ms, 30'600ms};
  const std::vector<milliseconds> steps =
      realGaps ? std::vector{0ms, 500ms, 29'500ms, 0ms, 600ms} : std::vector{0ms, 500ms, 10'000ms, 10'000ms, 600ms};
  std::vector<std::pair<int, std::int64_t>> expected;  // number, moment in ms
  std::chrono::nanoseconds playing{0};
  std::int64_t last = 0;
  for (std::size_t round = 0; round < (loop ? rounds : 1); ++round) {
    bool played = false;
    for (std::size_t number = 0; number < times.size(); ++number) {
      if (recorded[number] < start) continue;
      if (played) {
        playing += steps[number];
      } else {
        // The event before the start is played at once, and the rest of the gap after it is shortened.
        if (number > 0 && start > 0ms) expected.emplace_back(static_cast<int>(number) - 1, last);
        const std::chrono::nanoseconds left = recorded[number] - start;
        playing += realGaps ? left : std::min<std::chrono::nanoseconds>(left, 10s);
      }
      played = true;
      last = std::isinf(speed) ? 0 : std::llround(static_cast<double>(playing.count()) / 1e6 / speed);
      expected.emplace_back(static_cast<int>(number), last);
    }
    if (!played) {
      expected.emplace_back(4, 0);  // the last values, and no further round
      break;
    }
    playing += 1s;
  }
  Played played;
  PlayedSink sink(played, loop ? expected.size() : times.size() + 1);
  Player player(std::make_unique<ListStream>(times), {speed, loop, start, realGaps},
                std::make_unique<InstantClock>(played));
  player.start(sink);
  EXPECT_TRUE(eventually([&] { return played.count >= expected.size(); }));
  player.stop();
  std::vector<std::pair<int, std::int64_t>> found;
  for (const auto& [number, moment] : played.events) found.emplace_back(number, std::llround(moment / 1.0ms));
  EXPECT_EQ(found, expected);
}

INSTANTIATE_TEST_SUITE_P(AllOptions, PlayerWith,
                         testing::Combine(testing::Values(1, 10, 0.5, 10'000, PlaybackOptions::maximum),
                                          testing::Bool(), testing::Values(0ns, 300ms, 500ms, 15s, 31s),
                                          testing::Bool()));

TEST(Player, EndsWithAnEmptyStreamAndWithOneThatCannotBeRewound) {
  for (const bool empty : {true, false}) {
    const auto clock = std::make_shared<TestClock::State>();
    Collector collector;
    auto stream = std::make_unique<ListStream>(empty ? std::vector<milliseconds>() : std::vector{0ms}, empty);
    Player player(std::move(stream), {.loop = true}, std::make_unique<TestClock>(clock));
    player.start(collector);
    EXPECT_TRUE(eventually([&] { return empty || collector.numbers().size() == 1; }));
    clock->advanceTo(24h);
    player.stop();
    EXPECT_EQ(collector.numbers().size(), empty ? 0U : 1U);
  }
}

TEST(Player, LogsWhyItsStreamEndedEarly) {
  LogLines lines;
  auto stream = std::make_unique<ListStream>(std::vector{0ms});
  stream->failureText = "packet 2 is cut short";
  Collector collector;
  Player player(std::move(stream), {});
  player.start(collector);
  EXPECT_TRUE(eventually([&] { return !lines.taken().empty(); }));
  player.stop();
  EXPECT_THAT(lines.taken(), ElementsAre("list: packet 2 is cut short"));
  EXPECT_EQ(player.label(), "list");
}

TEST(Player, NamesInItsLabelWhyAStreamCannotBeRead) {
  const LogLines lines;
  auto stream = std::make_unique<ListStream>(std::vector<milliseconds>());
  stream->failureText = "standard input: is empty";
  Collector collector;
  Player player(std::move(stream), {});
  player.start(collector);
  EXPECT_TRUE(eventually([&] { return player.label() == "list (standard input: is empty)"; }));
}

// A stream with events of several metrics: each event's metric is its time in seconds modulo three.
class ThreeMetrics final : public sources::EventStream {
 public:
  [[nodiscard]] std::string label() const override { return "three"; }
  [[nodiscard]] SourceKind kind() const override { return SourceKind::recorded; }
  [[nodiscard]] std::optional<MetricEvent> next() override {
    if (next_ == 60) return std::nullopt;
    const auto number = static_cast<std::uint8_t>(next_++);
    return MetricEvent{number % 3, 0, {number}, std::chrono::seconds(number)};
  }
  void rewind() override { next_ = 0; }
  [[nodiscard]] std::optional<MetricEvent> simCardFiles(std::stop_token) override { return std::nullopt; }

 private:
  int next_ = 0;
};

TEST(Player, DeliversTheStateAtTheStartFirst) {
  const auto clock = std::make_shared<TestClock::State>();
  Collector collector;
  Player player(std::make_unique<ThreeMetrics>(), {.start = 20s + 500ms}, std::make_unique<TestClock>(clock));
  player.start(collector);
  EXPECT_TRUE(eventually([&] { return collector.numbers().size() == 3; }));
  EXPECT_THAT(collector.numbers(), ElementsAre(18, 19, 20));
  EXPECT_EQ(player.playback()->position, 20'500ms);
  EXPECT_EQ(player.playback()->clock, 20'500ms);
  clock->advanceTo(500ms);
  EXPECT_TRUE(eventually([&] { return collector.numbers().size() == 4; }));
  EXPECT_EQ(collector.numbers().back(), 21);
  player.stop();
}

TEST(Player, SaysThatTheStartIsBehindTheEndAndDeliversTheLastState) {
  LogLines lines;
  Collector collector;
  Player player(std::make_unique<ThreeMetrics>(), {.loop = true, .start = 61s});
  player.start(collector);
  EXPECT_TRUE(eventually([&] { return player.playback() && player.playback()->ended; }));
  EXPECT_THAT(collector.numbers(), ElementsAre(57, 58, 59));
  EXPECT_EQ(player.label(), "three (start=61.0 s is after the end of the recording at 59.0 s)");
  EXPECT_THAT(lines.taken(), ElementsAre("three: start=61.0 s is after the end of the recording at 59.0 s: its last "
                                         "values follow, and nothing is played"));
  EXPECT_EQ(player.playback()->position, 59s);
  player.stop();
}

TEST(Player, ReportsPositionLengthAndClockOfTheRecordingWithItsHoles) {
  const auto clock = std::make_shared<TestClock::State>();
  Collector collector;
  Player player(std::make_unique<ListStream>(std::vector{1'000'000ms, 1'001'000ms, 1'060'000ms, 1'060'500ms}),
                {.speed = 2}, std::make_unique<TestClock>(clock));
  EXPECT_EQ(player.playback(), std::nullopt);
  player.start(collector);
  EXPECT_TRUE(eventually([&] { return player.playback() && player.playback()->length; }));
  EXPECT_EQ(player.playback()->length, 60'500ms);
  EXPECT_EQ(player.playback()->position, 0ms);
  EXPECT_EQ(player.playback()->clock, 1'000'000ms);
  EXPECT_EQ(player.playback()->speed, 2);
  clock->advanceTo(5500ms);
  EXPECT_TRUE(eventually([&] { return collector.numbers().size() == 3; }));
  EXPECT_EQ(player.playback()->position, 60'000ms);
  EXPECT_EQ(player.playback()->clock, 1'060'000ms);
  EXPECT_FALSE(player.playback()->ended);
  clock->advanceTo(1h);
  EXPECT_TRUE(eventually([&] { return player.playback()->ended; }));
  EXPECT_EQ(player.playback()->position, 60'500ms);
  player.stop();
}

TEST(Player, ReportsNoLengthForWhatCannotBeReadAgain) {
  Collector collector;
  Player player(std::make_unique<ListStream>(std::vector{0ms, 1ms}, false), {});
  player.start(collector);
  EXPECT_TRUE(eventually([&] { return player.playback() && player.playback()->ended; }));
  EXPECT_EQ(player.playback()->length, std::nullopt);
}

TEST(Player, ReportsTheEndOfARecordingWithoutEvents) {
  Collector collector;
  Player player(std::make_unique<ListStream>(std::vector<milliseconds>()), {.loop = true});
  player.start(collector);
  EXPECT_TRUE(eventually([&] { return player.playback() && player.playback()->ended; }));
  EXPECT_EQ(player.playback()->position, 0ms);
}

TEST(Player, ReportsNoPositionForAModel) {
  auto stream = std::make_unique<ListStream>(std::vector{0ms, 1ms});
  stream->sourceKind = SourceKind::simulated;
  Collector collector;
  Player player(std::move(stream), {});
  player.start(collector);
  EXPECT_TRUE(eventually([&] { return collector.numbers().size() == 2; }));
  player.stop();
  EXPECT_EQ(player.playback(), std::nullopt);
}

TEST(Player, NeverEndsWhileItLoops) {
  Collector collector;
  Player player(std::make_unique<ListStream>(std::vector{0ms, 1ms}), {.speed = 10'000, .loop = true});
  player.start(collector);
  EXPECT_TRUE(eventually([&] { return collector.numbers().size() > 5; }));
  EXPECT_FALSE(player.playback()->ended);
  player.stop();
  EXPECT_FALSE(player.playback()->ended);
}

TEST(Player, WithAStartPlaysEachRoundWithoutMoreDelayThanTheOneBefore) {
  Collector collector;
  const auto begin = std::chrono::steady_clock::now();
  Player player(std::make_unique<ListStream>(std::vector{0ms, 1000ms, 2000ms}),
                {.speed = 10, .loop = true, .start = 500ms});
  player.start(collector);
  // Four events per round (the state first), 250 ms each.
  EXPECT_TRUE(eventually([&] { return collector.numbers().size() >= 4 * 3; }));
  EXPECT_LT(std::chrono::steady_clock::now() - begin, 1300ms);
  player.stop();
}

}  // namespace
}  // namespace vespscope::test
