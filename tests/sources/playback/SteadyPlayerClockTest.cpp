// The real clock of a player.
#include <chrono>
#include <thread>

#include <gtest/gtest.h>

#include "sources/playback/PlayerClock.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using sources::SteadyPlayerClock;

TEST(SteadyPlayerClock, ContinuesFromALongDelayInsteadOfMakingUpForIt) {
  SteadyPlayerClock clock;
  clock.begin();
  std::this_thread::sleep_for(200ms);
  const auto begin = std::chrono::steady_clock::now();
  EXPECT_TRUE(clock.waitUntil(0ms));  // 200 ms late, of which 20 ms are caught up with
  EXPECT_TRUE(clock.waitUntil(100ms));
  EXPECT_GE(std::chrono::steady_clock::now() - begin, 79ms);
}

TEST(SteadyPlayerClock, MakesUpForAShortDelay) {
  EXPECT_EQ(SteadyPlayerClock::notMadeUpFor(-5ms), 0ms);
  EXPECT_EQ(SteadyPlayerClock::notMadeUpFor(20ms), 0ms);
  EXPECT_EQ(SteadyPlayerClock::notMadeUpFor(21ms), 1ms);
}

TEST(SteadyPlayerClock, IsEarlyByNoMoreThanItsTolerance) {
  SteadyPlayerClock clock;
  const auto before = std::chrono::steady_clock::now();
  clock.begin();
  for (const auto moment : {0us, 100us, 3000us, 3100us, 20000us}) {
    EXPECT_TRUE(clock.waitUntil(moment));
    EXPECT_GE(std::chrono::steady_clock::now() - before, moment - SteadyPlayerClock::tolerance);
  }
}

TEST(SteadyPlayerClock, HeedsAnInterruptionWhetherOrNotThereIsAnythingToWaitFor) {
  SteadyPlayerClock clock;
  clock.begin();
  std::thread interrupter([&clock] { clock.interrupt(); });
  EXPECT_FALSE(clock.waitUntil(10h));
  interrupter.join();
  EXPECT_FALSE(clock.waitUntil(0s));
  EXPECT_FALSE(clock.waitUntil(10h));
}

}  // namespace
}  // namespace vespscope::test
