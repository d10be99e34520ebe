// The presence word of a message: one bit per field.
#include <bit>
#include <cstdint>

#include <gtest/gtest.h>

#include "messages/Storage.h"

namespace vespscope::test {
namespace {

template <class Word>
void countsWhatIsSet() {
  constexpr unsigned width = 8 * sizeof(Word);
  std::uint64_t random = 0x9E3779B97F4A7C15;
  for (int round = 0; round < 1000; ++round) {
    random ^= random << 13;
    random ^= random >> 7;
    random ^= random << 17;
    const auto word = static_cast<Word>(round == 0 ? ~std::uint64_t{0} : random);
    Presence<Word> presence;
    for (unsigned bit = 0; bit < width; ++bit) presence.set(bit, (word >> bit & 1) != 0);
    ASSERT_EQ(presence.count(), static_cast<std::size_t>(std::popcount(word))) << word;
  }
}

TEST(MessagePresenceWord, CountsWhatIsSet) {
  countsWhatIsSet<std::uint8_t>();
  countsWhatIsSet<std::uint16_t>();
  countsWhatIsSet<std::uint32_t>();
  countsWhatIsSet<std::uint64_t>();
}

TEST(MessagePresenceWord, DistinguishesEachBit) {
  Presence<std::uint64_t> presence;
  for (unsigned bit = 0; bit < 64; ++bit) {
    presence.set(bit);
    for (unsigned other = 0; other < 64; ++other) EXPECT_EQ(presence.test(other), other == bit);
    presence.set(bit, false);
    EXPECT_FALSE(presence.test(bit));
  }
}

}  // namespace
}  // namespace vespscope::test
