// The hash of contents has its published values and distinguishes lists.
#include <cstdint>
#include <set>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "messages/ContentHash.h"

namespace vespscope::test {
namespace {

TEST(ContentHash, IsFnv1aOf64Bits) {
  // Values that the function's authors publish.
  EXPECT_EQ(contentHash(std::string()), 0xCBF29CE484222325U);
  EXPECT_EQ(contentHash(std::string("a")), 0xAF63DC4C8601EC8CU);
  EXPECT_EQ(contentHash(std::string("foobar")), 0x85944171F73967E8U);
  EXPECT_EQ(contentHash(std::vector<std::uint8_t>{'a'}), 0xAF63DC4C8601EC8CU);
}

std::uint64_t hashOfList(const std::vector<std::uint64_t>& numbers) {
  std::uint64_t hash = 0;
  for (const std::uint64_t number : numbers) hash = addToHash(hash, number);
  return hash;
}

TEST(ContentHashOfLists, DistinguishesShortLists) {
  std::set<std::uint64_t> hashes = {hashOfList({})};
  std::size_t lists = 1;
  for (std::uint64_t first = 0; first < 40; ++first) {
    hashes.insert(hashOfList({first}));
    ++lists;
    for (std::uint64_t second = 0; second < 40; ++second) {
      hashes.insert(hashOfList({first, second}));
      hashes.insert(hashOfList({first, second, first}));
      lists += 2;
    }
  }
  EXPECT_EQ(hashes.size(), lists);
}

TEST(ContentHashOfLists, CarriesUpperBitsToLowerOnes) {
  std::set<std::uint64_t> low;
  for (std::uint64_t number = 0; number < 64; ++number) low.insert(hashOfList({number << 40}) & 0xFFFF);
  EXPECT_GT(low.size(), 60U);
}

}  // namespace
}  // namespace vespscope::test
