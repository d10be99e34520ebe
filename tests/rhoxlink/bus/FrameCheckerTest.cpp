// Each bound on a peer's data, one below and one above.
#include <cstdint>
#include <memory>
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "rhoxlink/bus/FrameChecker.h"

namespace vespscope::test {
namespace {

using bus::FrameChecker;
using bus::MemoryBudget;
using bus::WireLimits;
using Bytes = std::vector<std::uint8_t>;
using namespace std::chrono_literals;

constexpr std::uint8_t methodCall = 1;
constexpr std::uint8_t signalType = 4;
constexpr std::size_t headerSize = 16;

Bytes numberOf(std::uint32_t number, bool little) {
  Bytes bytes(4);
  for (std::size_t index = 0; index < 4; ++index) {
    bytes[little ? index : 3 - index] = static_cast<std::uint8_t>(number >> (8 * index));
  }
  return bytes;
}

// The first 16 bytes of a message.
Bytes header(std::uint32_t fields, std::uint32_t body, std::uint8_t type = signalType, bool little = true) {
  Bytes bytes{static_cast<std::uint8_t>(little ? 'l' : 'B'), type, 0, 1};
  for (const std::uint32_t number : {body, std::uint32_t{1}, fields}) {
    const Bytes digits = numberOf(number, little);
    bytes.insert(bytes.end(), digits.begin(), digits.end());
  }
  return bytes;
}

// A whole message: its header, and zeros for the rest.
Bytes message(std::uint32_t fields, std::uint32_t body, bool little = true) {
  Bytes bytes = header(fields, body, signalType, little);
  bytes.resize(headerSize + (fields + 7) / 8 * 8 + body);
  return bytes;
}

Bytes textOf(const std::string& text) { return {text.begin(), text.end()}; }

std::string refusalOf(FrameChecker& checker, const Bytes& bytes, bool authenticated = true) {
  const Result<std::size_t> admitted = checker.admit(bytes, authenticated);
  return admitted ? "" : admitted.reason();
}

constexpr WireLimits defaults;

TEST(FrameChecker, AdmitsTheAuthenticationALineAtATime) {
  FrameChecker checker(defaults);
  EXPECT_EQ(*checker.admit(textOf("AUTH EXTERNAL\r\nBEGIN\r\n"), false), 15U);
  EXPECT_EQ(*checker.admit(textOf("BEG"), false), 3U);
  EXPECT_EQ(*checker.admit(textOf("IN\r\nl"), false), 4U);
  EXPECT_TRUE(checker.unfinished());
  EXPECT_EQ(*checker.admit(message(0, 0), true), headerSize);
  EXPECT_FALSE(checker.unfinished());
}

TEST(FrameChecker, BoundsTheBytesOfTheAuthentication) {
  FrameChecker below(defaults);
  EXPECT_EQ(refusalOf(below, Bytes(defaults.authentication - 1, 'A'), false), "");
  EXPECT_EQ(refusalOf(below, textOf("\n"), false), "");
  FrameChecker above(defaults);
  EXPECT_EQ(refusalOf(above, Bytes(defaults.authentication, 'A'), false), "");
  EXPECT_EQ(refusalOf(above, textOf("\n"), false), "the peer's authentication is too long: the limit is 4096 bytes");
}

TEST(FrameChecker, BoundsTheSizeOfAMessageInEitherByteOrder) {
  for (const bool little : {true, false}) {
    const auto body = static_cast<std::uint32_t>(defaults.message - headerSize - 8);
    FrameChecker below(defaults);
    const Bytes largest = message(5, body, little);
    EXPECT_EQ(largest.size(), defaults.message);
    EXPECT_EQ(*below.admit(largest, true), largest.size());
    FrameChecker above(defaults);
    EXPECT_EQ(refusalOf(above, header(5, body + 1, signalType, little)),
              "the peer's message has 1052673 bytes: the limit is 1052672 bytes");
    EXPECT_NE(refusalOf(above, header(0, 0xFFFFFFFF, signalType, little)), "");
  }
}

TEST(FrameChecker, BoundsTheFieldsOfAHeader) {
  FrameChecker below(defaults);
  EXPECT_EQ(refusalOf(below, header(static_cast<std::uint32_t>(defaults.fields), 0)), "");
  FrameChecker above(defaults);
  EXPECT_EQ(refusalOf(above, header(static_cast<std::uint32_t>(defaults.fields) + 1, 0)),
            "the header of the peer's message has 4097 bytes of fields: the limit is 4096 bytes");
  EXPECT_NE(refusalOf(above, header(0xFFFFFFFF, 0)), "");
}

TEST(FrameChecker, AdmitsMessagesHoweverTheyAreCut) {
  Bytes stream;
  for (const std::uint32_t body : {0U, 1U, 40U, 70'000U, 3U}) {
    const Bytes next = message(body % 11, body, body % 2 == 0);
    stream.insert(stream.end(), next.begin(), next.end());
  }
  for (const std::size_t step : {1U, 15U, 16U, 17U, 1000U}) {
    FrameChecker checker(defaults);
    std::size_t passed = 0;
    std::size_t come = 0;
    while (passed < stream.size()) {
      come = std::min(std::max(come, passed) + step, stream.size());
      const auto admitted = checker.admit(std::span(stream).subspan(passed, come - passed), true);
      ASSERT_TRUE(admitted.ok()) << step;
      passed += *admitted;
    }
    EXPECT_FALSE(checker.unfinished());
  }
}

TEST(FrameChecker, RefusesWhatIsNoMessage) {
  Bytes wrongVersion = header(0, 0);
  wrongVersion[3] = 2;
  for (const Bytes& bytes : {Bytes(headerSize, 0xA5), header(0, 0, 0), header(0, 0, 5), wrongVersion}) {
    FrameChecker checker(defaults);
    EXPECT_EQ(refusalOf(checker, bytes), "the peer sent bytes that are not a D-Bus message");
  }
}

TEST(FrameChecker, LetsOnlyClientsCallMethods) {
  FrameChecker server(defaults);
  EXPECT_EQ(refusalOf(server, header(0, 0, methodCall)), "");
  FrameChecker client(WireLimits::ofClient());
  EXPECT_EQ(refusalOf(client, header(0, 0, signalType)), "");
  EXPECT_EQ(refusalOf(client, header(0, 0, methodCall)), "the peer calls methods, which only a client does");
}

TEST(FrameChecker, BoundsTheTimeOfTheAuthentication) {
  FrameChecker checker(defaults);
  EXPECT_TRUE(checker.waited(defaults.authenticationTime).ok());
  const Result<bool> refused = checker.waited(1ms);
  ASSERT_FALSE(refused.ok());
  EXPECT_EQ(refused.reason(), "the peer did not authenticate within 10000 ms");
}

TEST(FrameChecker, BoundsTheTimeOfEachMessage) {
  FrameChecker checker(defaults);
  const Bytes whole = message(0, 100);
  ASSERT_TRUE(checker.admit(std::span(whole).first(50), true).ok());
  EXPECT_TRUE(checker.waited(defaults.messageTime).ok());
  ASSERT_TRUE(checker.admit(std::span(whole).subspan(50), true).ok());
  EXPECT_TRUE(checker.waited(24h).ok());                             // nothing is expected between messages
  ASSERT_TRUE(checker.admit(std::span(whole).first(3), true).ok());  // an incomplete header
  EXPECT_TRUE(checker.waited(defaults.messageTime).ok());
  const Result<bool> refused = checker.waited(1ms);
  ASSERT_FALSE(refused.ok());
  EXPECT_EQ(refused.reason(), "the peer did not finish a message within 30000 ms");
}

TEST(FrameChecker, LetsALargeMessageWaitForRoomInTheBudget) {
  const auto budget = std::make_shared<MemoryBudget>(200'000);
  const auto large = static_cast<std::uint32_t>(100'000 - headerSize);
  FrameChecker first(defaults, budget);
  EXPECT_EQ(*first.admit(header(0, large), true), headerSize);
  EXPECT_EQ(budget->taken(), 100'000U);
  FrameChecker second(defaults, budget);
  EXPECT_EQ(*second.admit(header(0, large + 1), true), 0U);
  EXPECT_TRUE(second.waitsForRoom());
  // The budget is used up to its last byte.
  FrameChecker third(defaults, budget);
  EXPECT_EQ(*third.admit(header(0, large), true), headerSize);
  EXPECT_EQ(budget->taken(), 200'000U);
  EXPECT_EQ(*first.admit(Bytes(large), true), large);
  EXPECT_EQ(*second.admit(header(0, large + 1), true), 0U);
  EXPECT_EQ(*third.admit(Bytes(large), true), large);
  EXPECT_EQ(budget->taken(), 0U);
  EXPECT_EQ(*second.admit(header(0, large + 1), true), headerSize);
  EXPECT_FALSE(second.waitsForRoom());
}

TEST(FrameChecker, TakesNothingOfTheBudgetForASmallMessage) {
  const auto budget = std::make_shared<MemoryBudget>(0);
  FrameChecker checker(defaults, budget);
  const auto body = static_cast<std::uint32_t>(defaults.unbudgeted - headerSize);
  EXPECT_EQ(*checker.admit(header(0, body), true), headerSize);
  EXPECT_EQ(*checker.admit(Bytes(body), true), body);
  EXPECT_EQ(*checker.admit(header(0, body + 1), true), 0U);
  EXPECT_TRUE(checker.waitsForRoom());
}

TEST(FrameChecker, GivesBackItsShareOfTheBudgetWhenThePeerIsGone) {
  const auto budget = std::make_shared<MemoryBudget>(1'000'000);
  {
    FrameChecker checker(defaults, budget);
    ASSERT_TRUE(checker.admit(header(0, 500'000), true).ok());
    EXPECT_EQ(budget->taken(), 500'016U);
  }
  EXPECT_EQ(budget->taken(), 0U);
}

}  // namespace
}  // namespace vespscope::test
