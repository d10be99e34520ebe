#include <signal.h>

#include <gtest/gtest.h>

#include "platform/dispatch/SignalWatch.h"

namespace vespscope::dispatch {
namespace {

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

TEST(SignalWatch, TwoWatchesAtATimeAreAProgrammingError) {
  MainLoop loop;
  const SignalWatch watch(loop, [] {});
  EXPECT_DEATH(SignalWatch(loop, [] {}), "fatal: signals are watched already");
}

}  // namespace
}  // namespace vespscope::dispatch
