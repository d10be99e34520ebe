// Signals as tasks of a main loop.
#include <signal.h>

#include <chrono>
#include <vector>

#include <gtest/gtest.h>

#include "platform/dispatch/SignalWatch.h"

namespace vespscope::test {
namespace {

using namespace dispatch;

TEST(SignalWatch, ASignalBecomesATaskOfTheLoop) {
  for (const int signal : {SIGINT, SIGTERM}) {
    MainLoop loop;
    int calls = 0;
    const SignalWatch watch(loop, [&] {
      ++calls;
      loop.stop(3);
    });
    ::raise(signal);  // before the loop runs
    EXPECT_EQ(calls, 0);
    EXPECT_EQ(loop.run(), 3);
    EXPECT_EQ(calls, 1);
  }
}

TEST(SignalWatch, ASecondSignalEndsTheProcess) {
  EXPECT_EXIT(
      {
        MainLoop loop;
        const SignalWatch watch(loop, [] {});
        ::raise(SIGTERM);
        ::raise(SIGTERM);
      },
      testing::KilledBySignal(SIGTERM), "");
}

TEST(SignalWatch, AfterItsEndSignalsHaveTheirDefaultAgain) {
  EXPECT_EXIT(
      {
        MainLoop loop;
        {
          const SignalWatch watch(loop, [] {});
        }
        ::raise(SIGINT);
      },
      testing::KilledBySignal(SIGINT), "");
}

TEST(SignalWatch, GivesEachSignalThatIsAlwaysWatchedToTheAction) {
  MainLoop loop;
  std::vector<int> received;
  SignalWatch watch(loop, {{}, {SIGHUP, SIGUSR1}, nullptr}, [&](int signal) { received.push_back(signal); });
  for (const int signal : {SIGUSR1, SIGHUP, SIGHUP}) ::raise(signal);
  while (received.size() < 3) loop.runOnce(std::chrono::milliseconds(1000));
  EXPECT_EQ(received, (std::vector<int>{SIGUSR1, SIGHUP, SIGHUP}));
}

TEST(SignalWatch, CallsWhatIsToHappenImmediatelyWithinTheHandler) {
  static int immediate = 0;
  MainLoop loop;
  const SignalWatch watch(loop, {{}, {SIGUSR1}, [](int signal) { immediate = signal; }}, [](int /*signal*/) {});
  ::raise(SIGUSR1);
  EXPECT_EQ(immediate, SIGUSR1);
}

TEST(SignalWatch, DeliversASignalOnceAsBefore) {
  EXPECT_EXIT(
      {
        MainLoop loop;
        SignalWatch watch(loop, {{}, {SIGUSR1}, nullptr}, [](int /*signal*/) {});
        ::raise(SIGUSR1);
        watch.deliverAsBefore(SIGUSR1);
      },
      testing::KilledBySignal(SIGUSR1), "");
}

TEST(SignalWatch, TwoWatchesAtATimeAreAProgrammingError) {
  MainLoop loop;
  const SignalWatch watch(loop, [] {});
  EXPECT_DEATH(SignalWatch(loop, [] {}), "fatal: signals are watched already");
}

}  // namespace
}  // namespace vespscope::test
