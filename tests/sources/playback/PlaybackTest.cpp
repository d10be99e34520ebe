// The moment at which each recorded event is played.
#include <chrono>
#include <cstdint>
#include <limits>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "sources/playback/Playback.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using sources::Playback;
using sources::PlaybackOptions;
using std::chrono::milliseconds;
using std::chrono::nanoseconds;
using testing::ElementsAre;

// The moments, in ms, at which events of the given times are played; -1 for a skipped one.
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

TEST(Playback, KeepsTheRecordedDistances) {
  EXPECT_THAT(momentsOf({}, {5000ms, 5000ms, 5250ms, 15'250ms}), ElementsAre(0, 0, 250, 10'250));
}

TEST(Playback, AtAnotherSpeedDividesTheRecordedDistances) {
  EXPECT_THAT(momentsOf({.speed = 10}, {0ms, 1000ms, 9000ms}), ElementsAre(0, 100, 900));
  EXPECT_THAT(momentsOf({.speed = 0.5}, {0ms, 1000ms, 9000ms}), ElementsAre(0, 2000, 18'000));
}

TEST(Playback, AtMaximumSpeedWaitsForNothing) {
  EXPECT_THAT(momentsOf({.speed = PlaybackOptions::maximum}, {0ms, 1000ms, 900'000ms}), ElementsAre(0, 0, 0));
}

TEST(Playback, ShortensASilenceOfMoreThanTenSecondsToTen) {
  EXPECT_THAT(momentsOf({}, {0ms, 10'000ms, 20'001ms, 1'296'000'000ms}), ElementsAre(0, 10'000, 20'000, 30'000));
}

TEST(Playback, PlaysTimeThatRunsBackwardsAsASilenceOfTenSeconds) {
  EXPECT_THAT(momentsOf({}, {100'000ms, 99'999ms, 100'099ms, 0ms}), ElementsAre(0, 10'000, 10'100, 20'100));
}

TEST(Playback, WithRealGapsKeepsEachSilenceAndNeverRunsBackwards) {
  EXPECT_THAT(momentsOf({.realGaps = true}, {0ms, 60'000ms, 1000ms, 3000ms}), ElementsAre(0, 60'000, 60'000, 62'000));
}

TEST(Playback, LeavesOutEventsBeforeTheStartInEachRound) {
  Playback playback({.loop = true, .start = 2s});
  EXPECT_THAT(momentsOf(playback, {0ms, 1999ms, 2500ms, 4000ms}), ElementsAre(-1, -1, 500, 2000));
  playback.restart();
  EXPECT_THAT(momentsOf(playback, {0ms, 1999ms, 2500ms}), ElementsAre(-1, -1, 3500));
}

TEST(Playback, CountsTheStartInTheRecordingsOwnTimeWithItsHoles) {
  // A gap of a minute, which ends 61 s into the recording although only 11 s are played.
  const std::vector<milliseconds> times = {0ms, 1000ms, 61'000ms, 62'000ms, 65'000ms};
  EXPECT_THAT(momentsOf({.start = 62s}, times), ElementsAre(-1, -1, -1, 0, 3000));
  EXPECT_THAT(momentsOf({.start = 62s, .realGaps = true}, times), ElementsAre(-1, -1, -1, 0, 3000));
  // The rest of the gap is shortened like any other.
  EXPECT_THAT(momentsOf({.start = 30s}, times), ElementsAre(-1, -1, 10'000, 11'000, 14'000));
  EXPECT_THAT(momentsOf({.start = 30s, .realGaps = true}, times), ElementsAre(-1, -1, 31'000, 32'000, 35'000));
  EXPECT_THAT(momentsOf({.start = 58s}, times), ElementsAre(-1, -1, 3000, 4000, 7000));
}

TEST(Playback, DoesNotOverflowAtTheBoundsOfTimeSpeedAndStart) {
  constexpr nanoseconds latest = Playback::latestMoment;
  const auto moments = [](const PlaybackOptions& options, const std::vector<nanoseconds>& times) {
    Playback playback(options);
    std::vector<nanoseconds> found;
    for (int round = 0; round < 3; ++round) {
      for (const nanoseconds time : times) found.push_back(playback.schedule(time).value_or(nanoseconds(-1)));
      playback.restart();
    }
    return found;
  };
  constexpr nanoseconds lastSecond = std::chrono::seconds(std::numeric_limits<std::uint32_t>::max());
  // 136 years, a hundred times slower.
  EXPECT_THAT(moments({.speed = 0.01, .loop = true, .realGaps = true}, {0ns, lastSecond}),
              ElementsAre(0ns, latest, latest, latest, latest, latest));
  // From the second round on, longer than the clock can count.
  EXPECT_EQ(moments({.speed = 10'000, .loop = true, .realGaps = true}, {0ns, lastSecond, 0ns, lastSecond}).back(),
            922'337'203'685'477ns);
  EXPECT_THAT(moments({.speed = 0.01, .loop = true, .realGaps = true}, {nanoseconds::min(), nanoseconds::max()}),
              ElementsAre(0ns, latest, latest, latest, latest, latest));
  EXPECT_THAT(moments({.start = 100'000'000s, .realGaps = true}, {nanoseconds::min(), nanoseconds::max()}),
              ElementsAre(-1ns, latest, -1ns, latest, -1ns, latest));
}

TEST(Playback, BeginsAnotherRoundAfterASecond) {
  Playback playback({.speed = 2, .loop = true});
  EXPECT_THAT(momentsOf(playback, {1000ms, 3000ms}), ElementsAre(0, 1000));
  playback.restart();
  EXPECT_THAT(momentsOf(playback, {1000ms, 3000ms}), ElementsAre(1500, 2500));
}

}  // namespace
}  // namespace vespscope::test
