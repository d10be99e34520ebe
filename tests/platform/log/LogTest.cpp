// Both channels of the log, their observers, and a stuck system log.
#include <fcntl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>
#include <thread>
#include <vector>

#include <gtest/gtest.h>

#include "platform/log/Log.h"

namespace vespscope::test {
namespace {

using namespace log;
using Lines = std::vector<std::pair<Channel, std::string>>;

TEST(Log, AnObserverSeesTheLinesOfBothChannelsInOrder) {
  Lines lines;
  const Observation observation(
      [&lines](Channel channel, std::string_view line) { lines.emplace_back(channel, line); });
  system("valid metricId tag");
  print("pushing metric file");
  EXPECT_EQ(lines,
            (Lines{{Channel::systemLog, "valid metricId tag"}, {Channel::standardOutput, "pushing metric file"}}));
}

TEST(Log, AnObserverSeesNothingAfterItsEnd) {
  Lines lines;
  {
    const Observation observation(
        [&lines](Channel channel, std::string_view line) { lines.emplace_back(channel, line); });
  }
  print("a line");
  EXPECT_TRUE(lines.empty());
}

TEST(Log, LinesAreMadePrintable) {
  std::string seen;
  const Observation observation([&seen](Channel, std::string_view line) { seen = line; });
  print("APN \x1B[31m\nnext");
  EXPECT_EQ(seen, "APN ␛[31m␊next");
}

TEST(Log, PrintWritesOneLineToStandardOutput) {
  testing::internal::CaptureStdout();
  print("Querying SIM files");
  EXPECT_EQ(testing::internal::GetCapturedStdout(), "Querying SIM files\n");
}

TEST(Log, LinesOfABatchAreWrittenTogetherWhenItsLastPartEnds) {
  testing::internal::CaptureStdout();
  std::string within;
  {
    const OutputBatch outer;
    {
      const OutputBatch inner;
      print("one");
    }
    std::thread([] { print("two"); }).join();
    within = testing::internal::GetCapturedStdout();
    testing::internal::CaptureStdout();
  }
  print("three");
  EXPECT_EQ(within, "");
  EXPECT_EQ(testing::internal::GetCapturedStdout(), "one\ntwo\nthree\n");
}

TEST(Log, ABatchDoesNotKeepMoreThanABlock) {
  const std::string line(1000, 'x');
  testing::internal::CaptureStdout();
  std::string within;
  {
    const OutputBatch batch;
    for (int count = 0; count < 20; ++count) print(line);
    within = testing::internal::GetCapturedStdout();
    testing::internal::CaptureStdout();
  }
  const std::size_t rest = testing::internal::GetCapturedStdout().size();
  EXPECT_GE(within.size(), 16384U);
  EXPECT_EQ(within.size() + rest, 20 * (line.size() + 1));
}

TEST(Log, WithoutALogDaemonTheSystemLogGoesToStandardError) {
  if (::access("/dev/log", F_OK) == 0) GTEST_SKIP() << "this machine has a log daemon";
  flush();  // lines logged before this test
  testing::internal::CaptureStderr();
  system("one");
  system("two");
  flush();
  EXPECT_EQ(testing::internal::GetCapturedStderr(), "one\ntwo\n");
}

TEST(Log, ABrokenStandardOutputIsCountedAndSurvived) {
  std::signal(SIGPIPE, SIG_IGN);
  int ends[2];
  ASSERT_EQ(::pipe(ends), 0);
  const int saved = ::dup(STDOUT_FILENO);
  ::dup2(ends[1], STDOUT_FILENO);
  ::close(ends[0]);
  ::close(ends[1]);
  print("into the void");
  ::dup2(saved, STDOUT_FILENO);
  ::close(saved);
  EXPECT_EQ(counters().outputFailures, 1U);
}

TEST(Log, AStuckSystemLogHoldsNoMoreThanItsBytesAndReportsLaterWhatIsMissing) {
  if (::access("/dev/log", F_OK) == 0) GTEST_SKIP() << "this machine has a log daemon";
  flush();
  int ends[2];
  ASSERT_EQ(::pipe(ends), 0);
  const int saved = ::dup(STDERR_FILENO);
  ::dup2(ends[1], STDERR_FILENO);
  const std::uint64_t before = counters().systemLinesDropped;
  constexpr std::size_t lineSize = std::size_t{1} << 20;
  system("first");
  for (int count = 0; count < 40; ++count) system(std::string(lineSize, 'x'));
  const std::uint64_t dropped = counters().systemLinesDropped - before;
  // The waiting lines, and those being written.
  EXPECT_GE(dropped, 40U - 2 * 8U);
  std::string text;
  const std::string told = "the system log did not keep up: " + std::to_string(dropped) + " lines are left out here\n";
  std::vector<char> piece(65536);
  while (text.find(told) == std::string::npos) {
    const ssize_t size = ::read(ends[0], piece.data(), piece.size());
    ASSERT_GT(size, 0);
    text.append(piece.data(), static_cast<std::size_t>(size));
  }
  EXPECT_EQ(text.size(), 6 + (40 - dropped) * (lineSize + 1) + told.size());
  flush();
  ::dup2(saved, STDERR_FILENO);
  for (const int descriptor : {saved, ends[0], ends[1]}) ::close(descriptor);
}

TEST(Log, DiscardedOutputsStillReachObservers) {
  int seen = 0;
  const Observation observation([&seen](Channel, std::string_view) { ++seen; });
  testing::internal::CaptureStdout();
  discardOutputs();
  print("unseen");
  system("unseen");
  discardOutputs(false);
  EXPECT_EQ(testing::internal::GetCapturedStdout(), "");
  EXPECT_EQ(seen, 2);
}

TEST(Log, LinesOfSeveralThreadsStayWhole) {
  testing::internal::CaptureStdout();
  std::vector<std::thread> threads;
  for (int thread = 0; thread < 4; ++thread) {
    threads.emplace_back([] {
      for (int line = 0; line < 200; ++line) print("0123456789");
    });
  }
  for (std::thread& thread : threads) thread.join();
  std::string expected;
  for (int line = 0; line < 800; ++line) expected += "0123456789\n";
  EXPECT_EQ(testing::internal::GetCapturedStdout(), expected);
}

// The writer thread of the system log exists by then, so the death tests run in a new process.
class LogFatal : public testing::Test {
 protected:
  void SetUp() override { testing::FLAGS_gtest_death_test_style = "threadsafe"; }
};

TEST_F(LogFatal, SaysWhatAndWhereAndAborts) {
  EXPECT_EXIT(fatal("an event without an integer identifier"), testing::KilledBySignal(SIGABRT),
              "^fatal: an event without an integer identifier \\(LogTest\\.cpp:[0-9]+\\)\n");
}

TEST_F(LogFatal, WritesTheLinesOfABatchFirst) {
  const OutputBatch batch;
  EXPECT_EXIT(
      {
        ::dup2(STDERR_FILENO, STDOUT_FILENO);
        print("the last event");
        fatal("stop");
      },
      testing::KilledBySignal(SIGABRT), "the last event\nfatal: stop ");
}

TEST_F(LogFatal, RunsTheHooksNewestFirst) {
  const FatalHook first([] { static_cast<void>(::write(STDERR_FILENO, "first ", 6) == 6); });
  const FatalHook second([] { static_cast<void>(::write(STDERR_FILENO, "second ", 7) == 7); });
  EXPECT_EXIT(fatal("stop"), testing::KilledBySignal(SIGABRT), "^second first fatal: stop ");
}

TEST_F(LogFatal, AHookThatFailsDoesNotRunTheHooksAgain) {
  const FatalHook hook([] { fatal("in the hook"); });
  EXPECT_EXIT(fatal("stop"), testing::KilledBySignal(SIGABRT), "^fatal: in the hook ");
}

}  // namespace
}  // namespace vespscope::test
