// EPS and GPRS session messages of literal bytes (3GPP TS 24.301 8.3, 24.008 9.5).
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "LiteralMessages.h"
#include "sources/diag/Bytes.h"
#include "sources/nas/EpsSession.h"
#include "sources/nas/Session.h"

namespace vespscope::test {
namespace {

using namespace sources::nas;
using testing::ElementsAre;

TEST(EpsSession, AnActivationTellsQualityNameAddressAndServers) {
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

TEST(EpsSession, ADedicatedBearerTellsTheOneItBelongsTo) {
  const auto message = epsSessionMessageOf(bytesOf("62 00 c5 05 01 01 03 21 31 00"));
  ASSERT_TRUE(message);
  EXPECT_EQ(message->kind, EpsSessionKind::activateDedicated);
  EXPECT_EQ(message->bearer, 6);
  EXPECT_EQ(message->linked, 5);
  EXPECT_EQ(message->qualityClass, 1);
}

TEST(EpsSession, TheEndOfABearerIsTold) {
  EXPECT_EQ(epsSessionMessageOf(bytesOf("52 00 cd 24"))->kind, EpsSessionKind::deactivate);
  EXPECT_EQ(epsSessionMessageOf(bytesOf("52 00 ce"))->kind, EpsSessionKind::deactivated);
  EXPECT_EQ(epsSessionMessageOf(bytesOf("52 00 c2"))->kind, EpsSessionKind::accepted);
  EXPECT_EQ(epsSessionMessageOf(bytesOf("52 00 c3 1f"))->kind, EpsSessionKind::rejected);
}

TEST(EpsSession, ReservedBearersAndOtherMessagesTellNothing) {
  for (const char* dump : {"", "52", "52 00", "42 00 cd 24", "02 01 d0 11", "57 00 cd 24", "52 00 ff"}) {
    EXPECT_FALSE(epsSessionMessageOf(bytesOf(dump))) << dump;
  }
}

TEST(EpsSession, AnActivationCutInItsMandatoryPartTellsNothing) {
  const Bytes bytes = bytesOf(literal::activateDefault);
  constexpr std::size_t mandatory = 3 + 2 + 10 + 6;
  for (std::size_t length = 0; length <= bytes.size(); ++length) {
    EXPECT_EQ(epsSessionMessageOf(Span(bytes).first(length)).has_value(), length >= mandatory) << length;
  }
}

TEST(PacketConfiguration, AddressesOfEachKindAreRead) {
  EXPECT_EQ(pdnAddressOf(bytesOf("02 00 00 00 00 00 00 00 01")),
            (PacketAddress{AddressKind::ipv6, bytesOf("00 00 00 00 00 00 00 01")}));
  EXPECT_EQ(pdnAddressOf(bytesOf("03 00 00 00 00 00 00 00 01 0a 01 02 03")),
            (PacketAddress{AddressKind::dual, bytesOf("0a 01 02 03 00 00 00 00 00 00 00 01")}));
  for (const char* dump : {"", "01 0a 01 02", "02 00", "03 00 00 00 00 00 00 00 01 0a", "05 00", "07"}) {
    EXPECT_FALSE(pdnAddressOf(bytesOf(dump))) << dump;
  }
  EXPECT_EQ(pdpAddressOf(bytesOf("01 57")), (PacketAddress{AddressKind::ipv6, {}}));
  EXPECT_EQ(pdpAddressOf(bytesOf("01 8d 0a 01 02 03 20 01 0d b8 00 00 00 00 00 00 00 00 00 00 00 01"))->kind,
            AddressKind::dual);
  for (const char* dump : {"", "01", "00 01", "01 21 0a", "01 57 00", "01 99"}) {
    EXPECT_FALSE(pdpAddressOf(bytesOf(dump))) << dump;
  }
}

TEST(PacketConfiguration, NamesOfAccessPointsAreLabelsWithDots) {
  EXPECT_EQ(accessPointNameOf(bytesOf("03 69 6d 73 03 61 2d 31")), "ims.a-1");
  for (const char* dump : {"", "00", "04 69 6d 73", "03 69 00 73", "03 69 2e 73", "03 69 1b 73"}) {
    EXPECT_FALSE(accessPointNameOf(bytesOf(dump))) << dump;
  }
}

TEST(PacketConfiguration, ServersOfBothProtocolsKeepTheirOrder) {
  EXPECT_THAT(
      nameServersOf(bytesOf("80 00 03 10 20 01 0d b8 00 00 00 00 00 00 00 00 00 00 00 53 00 0d 04 c0 00 02 35")),
      ElementsAre(bytesOf("20 01 0d b8 00 00 00 00 00 00 00 00 00 00 00 53"), bytesOf("c0 00 02 35")));
  // Nothing asked for yet, an address of zeros, a request instead of an answer, lengths past the end.
  for (const char* dump :
       {"", "80", "80 00 0d 00", "80 00 0d 04 00 00 00 00", "80 80 21 0a 01 00 00 0a 81 06 c0 00 02 35",
        "80 00 0d 05 c0 00 02 35", "80 80 21 06 02 00 00 06 81 01"}) {
    EXPECT_TRUE(nameServersOf(bytesOf(dump)).empty()) << dump;
  }
}

TEST(Session, ARequestNamesItsContextAndTheAnswerItsAddress) {
  const Bytes request = bytesOf(literal::activateContextRequest);
  const auto asked = sessionMessageOf(request);
  ASSERT_TRUE(asked);
  EXPECT_EQ(asked->kind, SessionKind::activateRequest);
  EXPECT_EQ(asked->transaction, 0);
  EXPECT_EQ(asked->accessPointId, 5);
  EXPECT_EQ(asked->accessPoint, "internet");
  const Bytes accept = bytesOf(literal::activateContextAccept);
  const auto given = sessionMessageOf(accept);
  ASSERT_TRUE(given);
  EXPECT_EQ(given->kind, SessionKind::activateAccept);
  EXPECT_EQ(given->transaction, 0);
  EXPECT_EQ(given->address, (PacketAddress{AddressKind::ipv4, bytesOf("0a 01 02 03")}));
  EXPECT_THAT(given->nameServers, ElementsAre(bytesOf("c0 00 02 35")));
}

TEST(Session, OtherMessagesTellNothing) {
  for (const char* dump : {"", "0a", "7a", "7a 85", "0a 48", "08 41", "0a 41 05 03 03 00"}) {
    EXPECT_FALSE(sessionMessageOf(bytesOf(dump))) << dump;
  }
  EXPECT_EQ(sessionMessageOf(bytesOf("7a 85 46 24"))->transaction, 5);
  EXPECT_EQ(sessionMessageOf(bytesOf("9a 43 1f"))->kind, SessionKind::activateReject);
}

}  // namespace
}  // namespace vespscope::test
