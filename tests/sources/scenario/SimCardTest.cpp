// The simulated SIM card's files in their codings.
#include <map>
#include <string>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "messages/mobility/ElementaryFile.h"
#include "messages/mobility/KCellularMmCommonInfo.h"
#include "messages/mobility/KCellularSimCardFiles.h"
#include "sources/scenario/Drive.h"
#include "sources/scenario/ScenarioStream.h"
#include "sources/scenario/SimCard.h"

namespace vespscope::test {
namespace {

using namespace sources;
using namespace sources::scenario;
using namespace std::chrono_literals;
using ::testing::ElementsAre;

std::map<std::uint32_t, Bytes> filesOf(const MetricEvent& event) {
  std::map<std::uint32_t, Bytes> files;
  const auto message = as<KCellularSimCardFiles>(event);
  for (std::size_t i = 0; message && i < message->efListsCount(); ++i) {
    files[message->efListAtIndex(i)->efId()] = *message->efListAtIndex(i)->content();
  }
  return files;
}

std::map<std::uint32_t, Bytes> files() { return filesOf(*makeScenarioStream(1, driveStart)->simCardFiles({})); }

// The digits of bytes with swapped halves, up to the padding.
std::string digitsOf(const Bytes& bytes) {
  std::string digits;
  for (const std::uint8_t byte : bytes) {
    for (const unsigned half : {byte & 0xFU, static_cast<unsigned>(byte) >> 4U}) {
      if (half > 9) return digits;
      digits += static_cast<char>('0' + half);
    }
  }
  return digits;
}

TEST(SimCard, TheIccidIsATestNumberWithARightCheckDigit) {
  const Bytes content = files().at(0x2FE2);
  ASSERT_EQ(content.size(), 10U);
  const std::string digits = digitsOf(content);
  EXPECT_TRUE(digits.starts_with("8999"));
  ASSERT_EQ(digits.size(), 19U);
  int sum = 0;
  for (std::size_t i = 0; i < digits.size(); ++i) {
    const int value = (digits[digits.size() - 1 - i] - '0') * (i % 2 == 1 ? 2 : 1);
    sum += value > 9 ? value - 9 : value;
  }
  EXPECT_EQ(sum % 10, 0);
}

TEST(SimCard, TheImsiIsOfTheTestNetworkInItsOddLengthCoding) {
  EXPECT_THAT(files().at(0x6F07), ElementsAre(0x08, 0x09, 0x10, 0x10, 0x10, 0x32, 0x54, 0x76, 0x98));
  Bytes identity = testImsi();
  EXPECT_EQ(identity.front() & 0xFU, 0x9U) << "an odd number of digits, of an IMSI";
  EXPECT_EQ(std::to_string(identity.front() >> 4U) + digitsOf({identity.begin() + 1, identity.end()}),
            "001010123456789");
}

TEST(SimCard, TheAdministrativeDataGiveTwoDigitsOfNetworkCode) {
  EXPECT_THAT(files().at(0x6FAD), ElementsAre(0x80, 0x00, 0x00, 0x02));
}

TEST(SimCard, TheProviderNameIsTextFilledUp) {
  const Bytes content = files().at(0x6F46);
  ASSERT_EQ(content.size(), 17U);
  EXPECT_EQ(content[0], 0x01);
  EXPECT_EQ(std::string(content.begin() + 1, content.begin() + 13), "Test Network");
  EXPECT_THAT(Bytes(content.begin() + 13, content.end()), ElementsAre(0xFF, 0xFF, 0xFF, 0xFF));
}

TEST(SimCard, TheLocationsAreOfTheHomeNetworkAndNotUpdated) {
  EXPECT_THAT(files().at(0x6F7E), ElementsAre(0xFF, 0xFF, 0xFF, 0xFF, 0x00, 0xF1, 0x10, 0xFF, 0xFE, 0xFF, 0x01));
  const Bytes packet = files().at(0x6F73);
  ASSERT_EQ(packet.size(), 14U);
  EXPECT_THAT(Bytes(packet.begin() + 7, packet.end()), ElementsAre(0x00, 0xF1, 0x10, 0xFF, 0xFE, 0xFF, 0x01));
  const Bytes eps = files().at(0x6FE3);
  ASSERT_EQ(eps.size(), 18U);
  EXPECT_THAT(Bytes(eps.begin() + 12, eps.end()), ElementsAre(0x00, 0xF1, 0x10, 0xFF, 0xFE, 0x01));
}

TEST(SimCard, TheAccessClassIsTheLastDigitOfTheImsi) {
  EXPECT_THAT(files().at(0x6F78), ElementsAre(0x02, 0x00));  // bit 9
}

TEST(SimCard, TheHomeNetworkIsPreferredInEveryTechnology) {
  EXPECT_THAT(files().at(0x6F62), ElementsAre(0x00, 0xF1, 0x10, 0xC0, 0x80));
}

TEST(SimCard, TheOwnNumberIsInternational) {
  const Bytes content = files().at(0x6F40);
  ASSERT_EQ(content.size(), 28U);
  EXPECT_EQ(content[14], 5) << "one byte of type and four of digits";
  EXPECT_EQ(content[15], 0x91);
  EXPECT_EQ(digitsOf({content.begin() + 16, content.begin() + 26}), "15550100");
}

TEST(SimCard, TheServiceTableAnnouncesTheFilesThatAreThere) {
  const Bytes table = files().at(0x6F38);
  const auto announces = [&](unsigned service) {
    return (table.at((service - 1) / 8) >> ((service - 1) % 8) & 1U) != 0;
  };
  EXPECT_TRUE(announces(19)) << "service provider name";
  EXPECT_TRUE(announces(21)) << "own number";
  EXPECT_TRUE(announces(43)) << "home network selector";
  EXPECT_TRUE(announces(85)) << "EPS mobility information";
}

TEST(SimCard, TheAnswerToAQueryIsStampedWithTheTimeOfTheDrive) {
  const auto stream = makeScenarioStream(1, driveStart);
  for (int i = 0; i < 100; ++i) (void)stream->next();
  const auto before = *stream->next();
  const MetricEvent answer = *stream->simCardFiles({});
  EXPECT_GE(answer.time, std::chrono::floor<std::chrono::milliseconds>(before.time) - 10ms);
  EXPECT_LE(answer.time, before.time + 10ms);
  const auto message = as<KCellularSimCardFiles>(answer);
  ASSERT_NE(message, nullptr);
  EXPECT_EQ(static_cast<std::int64_t>(message->timestamp()),
            std::chrono::floor<std::chrono::milliseconds>(answer.time).count());
}

TEST(SimCard, TheDriveReportsTheSameFilesAndTheSameImsi) {
  bool sawFiles = false;
  bool sawIdentity = false;
  for (const MetricEvent& event : driveOf(1, 10s)) {
    if (metricName(event) == "K_SIM_FILE_INFO") {
      EXPECT_EQ(filesOf(event), files());
      EXPECT_GE(files().size(), 12U);
      sawFiles = true;
    }
    if (const auto common = as<KCellularMmCommonInfo>(event)) {
      EXPECT_EQ(*common->imsi(), testImsi());
      sawIdentity = true;
    }
  }
  EXPECT_TRUE(sawFiles);
  EXPECT_TRUE(sawIdentity);
}

}  // namespace
}  // namespace vespscope::test
