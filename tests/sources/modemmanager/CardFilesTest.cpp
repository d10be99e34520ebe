// The SIM card's files in their coding.
#include <optional>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "sources/modemmanager/CardFiles.h"

namespace vespscope::test {
namespace {

using namespace sources;
using namespace sources::modemmanager;

std::optional<Bytes> fileOf(const SimCard& card, std::uint32_t id) {
  for (const CardFile& file : cardFiles(card)) {
    if (file.id == id) return file.content;
  }
  return std::nullopt;
}

SimCard named(const std::string& name) {
  SimCard card;
  card.operatorName = name;
  return card;
}

TEST(CardFiles, AreNoneForACardWithoutReportedContents) { EXPECT_TRUE(cardFiles({}).empty()); }

TEST(CardFiles, HoldTheIccidInTenBytesOfSwappedDigits) {
  SimCard card;
  card.iccid = "89990100000000000012";
  EXPECT_EQ(fileOf(card, 0x2FE2), (Bytes{0x98, 0x99, 0x10, 0x00, 0x00, 0x00, 0x00, 0x00, 0x00, 0x21}));
  card.iccid = "8999010000000000018";  // 19 digits: one half-byte is padded
  EXPECT_EQ(fileOf(card, 0x2FE2), (Bytes{0x98, 0x99, 0x10, 0x00, 0x00, 0x00, 0x00, 0x00, 0x10, 0xF8}));
  card.iccid = "899901000000000001";
  EXPECT_EQ(fileOf(card, 0x2FE2), (Bytes{0x98, 0x99, 0x10, 0x00, 0x00, 0x00, 0x00, 0x00, 0x10, 0xFF}));
}

TEST(CardFiles, HoldTheImsiWithItsLengthAndTheMarkOfAnOddNumberOfDigits) {
  SimCard card;
  card.imsi = "001010123456789";
  EXPECT_EQ(fileOf(card, 0x6F07), (Bytes{0x08, 0x09, 0x10, 0x10, 0x10, 0x32, 0x54, 0x76, 0x98}));
  card.imsi = "00101012345678";  // an even number of digits
  EXPECT_EQ(fileOf(card, 0x6F07), (Bytes{0x08, 0x01, 0x10, 0x10, 0x10, 0x32, 0x54, 0x76, 0xF8}));
  card.imsi = "00101012345";
  EXPECT_EQ(fileOf(card, 0x6F07), (Bytes{0x06, 0x09, 0x10, 0x10, 0x10, 0x32, 0x54, 0xFF, 0xFF}));
}

TEST(CardFiles, HaveOnlyTheLengthOfTheNetworkCodeInTheAdministrativeData) {
  SimCard card;
  card.operatorCode = "00101";
  EXPECT_EQ(fileOf(card, 0x6FAD), (Bytes{0xFF, 0xFF, 0xFF, 0x02}));
  card.operatorCode = "310260";
  EXPECT_EQ(fileOf(card, 0x6FAD), (Bytes{0xFF, 0xFF, 0xFF, 0x03}));
}

TEST(CardFiles, HoldTheProvidersNameInTheDefaultAlphabet) {
  EXPECT_EQ(fileOf(named("Test Network"), 0x6F46),
            (Bytes{0xFF, 'T', 'e', 's', 't', ' ', 'N', 'e', 't', 'w', 'o', 'r', 'k', 0xFF, 0xFF, 0xFF, 0xFF}));
  // @, $, _, é and Ö have other codes there than in ASCII and Latin-1.
  EXPECT_EQ(fileOf(named("@$_éÖ"), 0x6F46), (Bytes{0xFF, 0x00, 0x02, 0x11, 0x05, 0x5C, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF,
                                                   0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF}));
}

TEST(CardFiles, HoldAnyOtherNameInSixteenBits) {
  EXPECT_EQ(fileOf(named("МТС"), 0x6F46), (Bytes{0xFF, 0x80, 0x04, 0x1C, 0x04, 0x22, 0x04, 0x21, 0xFF, 0xFF, 0xFF, 0xFF,
                                                 0xFF, 0xFF, 0xFF, 0xFF, 0xFF}));
}

TEST(CardFiles, LeaveOutANameThatTheFileCannotHold) {
  EXPECT_EQ(fileOf(named("Sixteen letters!"), 0x6F46)->back(), '!');
  EXPECT_EQ(fileOf(named("Seventeen letters"), 0x6F46), std::nullopt);
  EXPECT_EQ(fileOf(named("ЁЁЁЁЁЁЁЁ"), 0x6F46), std::nullopt);
  EXPECT_EQ(fileOf(named("😀"), 0x6F46), std::nullopt);
  EXPECT_EQ(fileOf(named("\xFF"), 0x6F46), std::nullopt);
}

TEST(CardFiles, HoldTheGroupIdentifiersAsTheyAre) {
  SimCard card;
  card.gid1 = Bytes{0x42, 0xFF};
  card.gid2 = Bytes{0x07};
  EXPECT_EQ(fileOf(card, 0x6F3E), (Bytes{0x42, 0xFF}));
  EXPECT_EQ(fileOf(card, 0x6F3F), Bytes{0x07});
}

}  // namespace
}  // namespace vespscope::test
