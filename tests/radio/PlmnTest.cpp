// Networks: every form of a network code gives the same Plmn, and an invalid one gives nothing.
#include <gtest/gtest.h>

#include "radio/Plmn.h"

namespace vespscope::test {
namespace {

using radio::Plmn;

TEST(Plmn, HasTheSameOctetsFromEveryForm) {
  const auto german = Plmn::fromText("26201");
  ASSERT_TRUE(german);
  EXPECT_EQ(german->octets(), (Bytes{0x62, 0xF2, 0x10}));
  EXPECT_EQ(Plmn::fromOctets(Bytes{0x62, 0xF2, 0x10}), german);
  EXPECT_EQ(Plmn::fromNumbers(262, 1, 2), german);
  EXPECT_EQ(Plmn::fromDigitOctets(Bytes{2, 6, 2, 0, 1, 0xFF}), german);
  const auto american = Plmn::fromText("310260");
  ASSERT_TRUE(american);
  EXPECT_EQ(american->octets(), (Bytes{0x13, 0x00, 0x62}));
  EXPECT_EQ(Plmn::fromOctets(Bytes{0x13, 0x00, 0x62}), american);
  EXPECT_EQ(Plmn::fromNumbers(310, 260, 3), american);
  EXPECT_EQ(Plmn::fromDigitOctets(Bytes{3, 1, 0, 2, 6, 0}), american);
}

TEST(Plmn, DistinguishesTwoDigitsFromThree) {
  EXPECT_EQ(Plmn::fromNumbers(1, 1, 2)->text(), "001-01");
  EXPECT_EQ(Plmn::fromNumbers(1, 1, 3)->text(), "001-001");
  EXPECT_EQ(Plmn::fromText("00101")->mncDigits(), 2);
  EXPECT_EQ(Plmn::fromText("001001")->mncDigits(), 3);
  EXPECT_NE(Plmn::fromText("00101"), Plmn::fromText("001001"));
}

TEST(Plmn, GivesBackTheNumbersOfEveryNetwork) {
  for (std::uint32_t mcc = 0; mcc <= 999; mcc += 37) {
    for (std::uint32_t mnc = 0; mnc <= 999; ++mnc) {
      const auto three = Plmn::fromNumbers(mcc, mnc, 3);
      ASSERT_TRUE(three);
      EXPECT_EQ(three->mcc(), mcc);
      EXPECT_EQ(three->mnc(), mnc);
      EXPECT_EQ(Plmn::fromOctets(three->octets()), three);
      EXPECT_EQ(Plmn::fromNumbers(mcc, mnc, 2).has_value(), mnc <= 99);
    }
  }
}

TEST(Plmn, IsNothingOfDigitsThatAreNone) {
  for (const char* text : {"", "2620", "2620100", "2620x", "-6201", "26 01"})
    EXPECT_FALSE(Plmn::fromText(text)) << text;
  EXPECT_FALSE(Plmn::fromOctets(Bytes{0x62, 0xF2}));
  EXPECT_FALSE(Plmn::fromOctets(Bytes{0xFF, 0xFF, 0xFF}));
  EXPECT_FALSE(Plmn::fromOctets(Bytes{0x62, 0xA2, 0x10}));
  EXPECT_FALSE(Plmn::fromOctets(Bytes{0x62, 0xF2, 0x1F}));
  EXPECT_FALSE(Plmn::fromOctets(Bytes{0xA2, 0xF2, 0x10}));
  EXPECT_FALSE(Plmn::fromDigitOctets(Bytes{2, 6, 2, 0, 10, 0}));
  EXPECT_FALSE(Plmn::fromDigitOctets(Bytes{2, 6, 2, 0, 1}));
  EXPECT_FALSE(Plmn::fromNumbers(1000, 1, 2));
  EXPECT_FALSE(Plmn::fromNumbers(262, 100, 2));
  EXPECT_FALSE(Plmn::fromNumbers(262, 1000, 3));
  EXPECT_FALSE(Plmn::fromNumbers(262, 1, 1));
}

}  // namespace
}  // namespace vespscope::test
