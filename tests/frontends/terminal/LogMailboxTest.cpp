// Log lines on their way from other threads: bounded in number and bytes, the newest kept.
#include <clocale>
#include <thread>

#include <gtest/gtest.h>

#include "frontends/terminal/LogPane.h"

namespace vespscope::test {
namespace {

using namespace terminal;

TEST(LogMailbox, LinesBeyondItsCapacityReplaceTheOldestAndKeepTheirNumbers) {
  LogMailbox full;
  for (std::size_t number = 0; number < LogMailbox::capacity; ++number) {
    full.post(log::Channel::systemLog, std::to_string(number), {});
  }
  EXPECT_EQ(full.take().front().text, "0");
  LogMailbox mailbox;
  for (int number = 0; number < 2500; ++number) mailbox.post(log::Channel::systemLog, std::to_string(number), {});
  const auto lines = mailbox.take();
  ASSERT_EQ(lines.size(), LogMailbox::capacity);
  EXPECT_EQ(lines.front().text, "500");
  EXPECT_EQ(lines.front().number, 500U);
  EXPECT_TRUE(mailbox.empty());
}

TEST(LogMailbox, LongLinesAreBoundedByTheirBytesAndTheNewestStays) {
  LogMailbox mailbox;
  for (int number = 0; number < 100; ++number) {
    mailbox.post(log::Channel::systemLog, std::string(std::size_t{1} << 20, 'x') + std::to_string(number), {});
  }
  const auto lines = mailbox.take();
  ASSERT_EQ(lines.size(), 3U);  // three lines of over a megabyte are below 4 MiB
  EXPECT_EQ(lines.back().number, 99U);
  mailbox.post(log::Channel::systemLog, std::string(std::size_t{5} << 20, 'y'), {});
  EXPECT_EQ(mailbox.take().front().text.size(), std::size_t{5} << 20);
}

TEST(LogMailbox, ThreadsMayPostWhileAnotherOneTakes) {
  LogMailbox mailbox;
  constexpr int each = 500;
  std::vector<std::thread> threads;
  for (int thread = 0; thread < 3; ++thread) {
    threads.emplace_back([&mailbox] {
      for (int count = 0; count < each; ++count) mailbox.post(log::Channel::systemLog, "x", {});
    });
  }
  std::uint64_t next = 0;
  while (next < 3 * each) {
    for (const LogLine& line : mailbox.take()) EXPECT_EQ(line.number, next++);
  }
  for (std::thread& thread : threads) thread.join();
}

}  // namespace
}  // namespace vespscope::test
