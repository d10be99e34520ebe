// Texts in one block of memory: complete and in order wherever the block ends, however it grows.
#include <cstddef>
#include <deque>
#include <random>
#include <string>

#include <gtest/gtest.h>

#include "platform/log/TextRing.h"

namespace vespscope::test {
namespace {

using namespace log;

TEST(TextRing, GivesTextsBackInOrder) {
  TextRing ring;
  ring.push("one");
  ring.push("");
  ring.push("two");
  EXPECT_EQ(ring.size(), 6U);
  EXPECT_EQ(ring.pop(3), "one");
  EXPECT_EQ(ring.pop(0), "");
  EXPECT_EQ(ring.pop(3), "two");
  EXPECT_EQ(ring.size(), 0U);
}

TEST(TextRing, KeepsTextsWholeAcrossItsEndAndWhileItGrows) {
  TextRing ring;
  std::deque<std::string> expected;
  std::mt19937 random(7);
  for (int step = 0; step < 20'000; ++step) {
    // Runs of increasing length, so that the block grows at every position.
    if (expected.empty() || random() % 100 < 52) {
      expected.emplace_back(random() % 700, static_cast<char>('a' + step % 26));
      ring.push(expected.back());
    } else if (random() % 2 == 0) {
      EXPECT_EQ(ring.pop(expected.front().size()), expected.front());
      expected.pop_front();
    } else {
      ring.drop(expected.front().size());
      expected.pop_front();
    }
  }
  EXPECT_GT(ring.capacity(), std::size_t{1} << 17);
  for (const std::string& text : expected) EXPECT_EQ(ring.pop(text.size()), text);
  EXPECT_EQ(ring.size(), 0U);
}

TEST(TextRing, UsesTheSameMemoryOverAndOver) {
  TextRing ring;
  const std::string text(1000, 'x');
  for (int step = 0; step < 10; ++step) ring.push(text);
  const std::size_t capacity = ring.capacity();
  for (int step = 0; step < 100'000; ++step) {
    ring.drop(text.size());
    ring.push(text);
  }
  EXPECT_EQ(ring.capacity(), capacity);
}

TEST(TextRing, GivesMemoryBackOnlyWhereNothingNeedsIt) {
  TextRing ring;
  ring.push(std::string(1'000'000, 'x'));
  ring.shrink(100'000);
  EXPECT_GE(ring.capacity(), 1'000'000U);
  ring.drop(1'000'000);
  ring.shrink(2'000'000);
  EXPECT_GE(ring.capacity(), 1'000'000U);
  ring.shrink(100'000);
  EXPECT_LT(ring.capacity(), 100'000U);
  ring.push("after");
  EXPECT_EQ(ring.pop(5), "after");
}

}  // namespace
}  // namespace vespscope::test
