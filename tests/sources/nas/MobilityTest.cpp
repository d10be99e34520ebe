// MM and GMM messages from literal bytes (3GPP TS 24.008 9.2, 9.4).
#include <gtest/gtest.h>

#include "LiteralMessages.h"
#include "sources/diag/Bytes.h"
#include "sources/nas/Mobility.h"

namespace vespscope::test {
namespace {

using namespace sources::nas;
using Kind = MobilityKind;

const LocationArea area7145{*Plmn::fromText("310260"), 7145};

TEST(Mobility, AnAttachAcceptOfThePacketDomainGivesAreaIdentitiesAndTimer) {
  const auto message = mobilityMessageOf(bytesOf(literal::gmmAttachAccept));
  ASSERT_TRUE(message);
  EXPECT_EQ(message->domain, Domain::packet);
  EXPECT_EQ(message->kind, Kind::attachAccept);
  EXPECT_EQ(message->type, 3);
  EXPECT_EQ(message->updateTimerSeconds, 3240U);
  EXPECT_EQ(message->locationArea, area7145);
  EXPECT_EQ(message->routingAreaCode, 18);
  EXPECT_EQ(message->temporaryIdentity, 0xC0000001);
  EXPECT_EQ(message->tmsi, 0xD0000002);
  EXPECT_EQ(message->cause, 16);
  EXPECT_EQ(message->equivalentPlmns, (std::vector<Plmn>{*Plmn::fromText("26202")}));
}

TEST(Mobility, ARoutingAreaUpdateAcceptGivesTheSame) {
  const auto message = mobilityMessageOf(bytesOf(literal::routingUpdateAccept));
  ASSERT_TRUE(message);
  EXPECT_EQ(message->kind, Kind::updateAccept);
  EXPECT_EQ(message->type, 0);
  EXPECT_EQ(message->updateTimerSeconds, 3240U);
  EXPECT_EQ(message->locationArea, area7145);
  EXPECT_EQ(message->temporaryIdentity, 0xC0000001);
}

TEST(Mobility, RequestsGiveTheirType) {
  EXPECT_EQ(mobilityMessageOf(bytesOf(literal::gmmAttachRequest))->type, 3);
  const auto update = mobilityMessageOf(bytesOf("08 08 12 13 00 62 1b e9 12"));
  EXPECT_EQ(update->kind, Kind::updateRequest);
  EXPECT_EQ(update->type, 2);
  // The phone's second message of the circuit domain.
  const auto location = mobilityMessageOf(bytesOf("05 48 71 13 00 62 1b e9 57 05 f4 00 00 00 01"));
  EXPECT_EQ(location->domain, Domain::circuit);
  EXPECT_EQ(location->kind, Kind::updateRequest);
  EXPECT_EQ(location->type, 1);
}

TEST(Mobility, ALocationUpdateAcceptGivesAreaAndIdentity) {
  const auto message = mobilityMessageOf(bytesOf(literal::locationUpdateAccept));
  ASSERT_TRUE(message);
  EXPECT_EQ(message->domain, Domain::circuit);
  EXPECT_EQ(message->kind, Kind::updateAccept);
  EXPECT_EQ(message->locationArea, area7145);
  EXPECT_EQ(message->temporaryIdentity, 0xD0000002);
}

TEST(Mobility, ANewIdentityOfEitherDomainIsReported) {
  const auto circuit = mobilityMessageOf(bytesOf("05 1a 13 00 62 1b e9 05 f4 d0 00 00 03"));
  ASSERT_TRUE(circuit);
  EXPECT_EQ(circuit->kind, Kind::newIdentity);
  EXPECT_EQ(circuit->temporaryIdentity, 0xD0000003);
  const auto packet = mobilityMessageOf(bytesOf("08 10 05 f4 c0 00 00 03 13 00 62 1b e9 12 00"));
  ASSERT_TRUE(packet);
  EXPECT_EQ(packet->kind, Kind::newIdentity);
  EXPECT_EQ(packet->temporaryIdentity, 0xC0000003);
  EXPECT_EQ(packet->routingAreaCode, 18);
}

TEST(Mobility, RejectsGiveTheirCause) {
  for (const auto& [dump, domain, kind] : {std::tuple("08 04 0b", Domain::packet, Kind::attachReject),
                                           std::tuple("08 0b 0f", Domain::packet, Kind::updateReject),
                                           std::tuple("08 0e 28", Domain::packet, Kind::serviceReject),
                                           std::tuple("05 04 0d", Domain::circuit, Kind::updateReject),
                                           std::tuple("05 22 04", Domain::circuit, Kind::serviceReject)}) {
    const Bytes bytes = bytesOf(dump);
    const auto message = mobilityMessageOf(bytes);
    ASSERT_TRUE(message) << dump;
    EXPECT_EQ(message->domain, domain);
    EXPECT_EQ(message->kind, kind);
    EXPECT_EQ(message->cause, bytes[2]);
  }
}

TEST(Mobility, ADetachOfThePacketDomainOnlyIsReported) {
  EXPECT_EQ(mobilityMessageOf(bytesOf("08 05 09"))->kind, Kind::detach);
  EXPECT_EQ(mobilityMessageOf(bytesOf("05 01 13 05 f4 00 00 00 01"))->kind, Kind::detach);
  // From the network, it ends the attachment to the circuit domain; from the phone, to both.
  EXPECT_FALSE(mobilityMessageOf(bytesOf("08 05 03")));
}

TEST(Mobility, OtherMessagesGiveNothing) {
  for (const char* dump : {"", "05", "08", "05 18 01", "08 15 01", "03 02", "18 02", "08 05"}) {
    EXPECT_FALSE(mobilityMessageOf(bytesOf(dump))) << dump;
  }
}

TEST(Mobility, AMessageTruncatedInItsMandatoryPartGivesNothing) {
  for (const auto& [dump, mandatory] :
       {std::pair(literal::gmmAttachAccept, std::size_t{11}), std::pair(literal::routingUpdateAccept, std::size_t{10}),
        std::pair(literal::locationUpdateAccept, std::size_t{7}),
        std::pair(literal::gmmAttachRequest, std::size_t{6})}) {
    const Bytes bytes = bytesOf(dump);
    for (std::size_t length = 0; length <= bytes.size(); ++length) {
      EXPECT_EQ(mobilityMessageOf(Span(bytes).first(length)).has_value(), length >= mandatory) << dump << length;
    }
  }
}

}  // namespace
}  // namespace vespscope::test
