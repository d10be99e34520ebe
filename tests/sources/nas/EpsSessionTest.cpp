// EPS session messages of literal bytes (3GPP TS 24.301 8.3).
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "LiteralMessages.h"
#include "sources/diag/Bytes.h"
#include "sources/nas/EpsSession.h"

namespace vespscope::test {
namespace {

using namespace sources::nas;
using testing::ElementsAre;

TEST(EpsSession, AnActivationGivesQualityNameAddressAndServers) {
  const Bytes bytes = bytesOf(literal::activateDefault);
  const auto message = epsSessionMessageOf(bytes);
  ASSERT_TRUE(message);
  EXPECT_EQ(message->kind, EpsSessionKind::activateDefault);
  EXPECT_EQ(message->bearer, 5);
  EXPECT_EQ(message->qualityClass, 9);
  EXPECT_EQ(message->accessPoint, "internet");
  EXPECT_EQ(message->address, (PacketAddress{AddressKind::ipv4, bytesOf("0a 01 02 03")}));
  EXPECT_THAT(message->nameServers, ElementsAre(bytesOf("c0 00 02 35"), bytesOf("c6 33 64 35")));
}

TEST(EpsSession, ADedicatedBearerGivesItsDefaultBearer) {
  const auto message = epsSessionMessageOf(bytesOf("62 00 c5 05 01 01 03 21 31 00"));
  ASSERT_TRUE(message);
  EXPECT_EQ(message->kind, EpsSessionKind::activateDedicated);
  EXPECT_EQ(message->bearer, 6);
  EXPECT_EQ(message->linked, 5);
  EXPECT_EQ(message->qualityClass, 1);
}

TEST(EpsSession, TheEndOfABearerIsReported) {
  EXPECT_EQ(epsSessionMessageOf(bytesOf("52 00 cd 24"))->kind, EpsSessionKind::deactivate);
  EXPECT_EQ(epsSessionMessageOf(bytesOf("52 00 ce"))->kind, EpsSessionKind::deactivated);
  EXPECT_EQ(epsSessionMessageOf(bytesOf("52 00 c2"))->kind, EpsSessionKind::accepted);
  EXPECT_EQ(epsSessionMessageOf(bytesOf("52 00 c3 1f"))->kind, EpsSessionKind::rejected);
}

TEST(EpsSession, ReservedBearersAndOtherMessagesGiveNothing) {
  for (const char* dump : {"", "52", "52 00", "42 00 cd 24", "02 01 d0 11", "57 00 cd 24", "52 00 ff"}) {
    EXPECT_FALSE(epsSessionMessageOf(bytesOf(dump))) << dump;
  }
}

TEST(EpsSession, AnActivationTruncatedInItsMandatoryPartGivesNothing) {
  const Bytes bytes = bytesOf(literal::activateDefault);
  constexpr std::size_t mandatory = 3 + 2 + 10 + 6;
  for (std::size_t length = 0; length <= bytes.size(); ++length) {
    EXPECT_EQ(epsSessionMessageOf(Span(bytes).first(length)).has_value(), length >= mandatory) << length;
  }
}

}  // namespace
}  // namespace vespscope::test
