// EPS mobility messages from literal bytes (3GPP TS 24.301 8.2).
#include <gtest/gtest.h>

#include "LiteralMessages.h"
#include "sources/diag/Bytes.h"
#include "sources/nas/EpsMobility.h"

namespace vespscope::test {
namespace {

using namespace sources::nas;
using Kind = EpsMobilityKind;

const Plmn germany01 = *Plmn::fromText("26201");
const Plmn germany02 = *Plmn::fromText("26202");
const Plmn america410 = *Plmn::fromText("310410");

TEST(EpsMobility, AnAttachAcceptGivesAreasIdentitiesTimerAndFeatures) {
  const Bytes bytes = bytesOf(literal::attachAccept);
  const auto message = epsMobilityMessageOf(bytes);
  ASSERT_TRUE(message);
  EXPECT_EQ(message->kind, Kind::attachAccept);
  EXPECT_EQ(message->type, 2);
  EXPECT_EQ(message->trackingAreas, (std::vector<TrackingArea>{{germany01, 0x1234}}));
  EXPECT_EQ(message->guti, (Guti{germany01, 0x8001, 2, 0xC0000001}));
  EXPECT_EQ(message->locationArea, (LocationArea{germany01, 10'000}));
  EXPECT_EQ(message->tmsi, 0xD0000002);
  EXPECT_EQ(message->equivalentPlmns, (std::vector<Plmn>{germany02}));
  EXPECT_EQ(message->updateTimerSeconds, 7200U);
  EXPECT_EQ(message->imsVoice, true);
  EXPECT_EQ(message->emergencyBearers, false);
  EXPECT_FALSE(message->cause);
  const Bytes session = bytesOf(literal::activateDefault);
  EXPECT_EQ(Bytes(message->session.begin(), message->session.end()), session);
}

TEST(EpsMobility, AnAttachRequestGivesItsTypeAndThePhonesUsage) {
  const Bytes bytes = bytesOf(literal::attachRequest);
  const auto message = epsMobilityMessageOf(bytes);
  ASSERT_TRUE(message);
  EXPECT_EQ(message->kind, Kind::attachRequest);
  EXPECT_EQ(message->type, 2);
  EXPECT_EQ(message->dataCentric, false);
  EXPECT_EQ(message->session.size(), 4U);
}

TEST(EpsMobility, AnUpdateRequestGivesItsTypeAndThePhonesUsage) {
  const Bytes bytes = bytesOf(literal::updateRequest);
  const auto message = epsMobilityMessageOf(bytes);
  ASSERT_TRUE(message);
  EXPECT_EQ(message->kind, Kind::updateRequest);
  EXPECT_EQ(message->type, 1);
  EXPECT_EQ(message->dataCentric, true);
}

TEST(EpsMobility, AnUpdateAcceptHasListsOfAreasInThreeForms) {
  const Bytes bytes = bytesOf(literal::updateAccept);
  const auto message = epsMobilityMessageOf(bytes);
  ASSERT_TRUE(message);
  EXPECT_EQ(message->kind, Kind::updateAccept);
  EXPECT_EQ(message->type, 1);
  EXPECT_EQ(message->trackingAreas, (std::vector<TrackingArea>{{germany01, 0x1234},
                                                               {germany01, 0x1240},
                                                               {germany02, 0x2000},
                                                               {germany02, 0x2001},
                                                               {germany02, 0x2002},
                                                               {germany01, 1},
                                                               {america410, 2}}));
  EXPECT_EQ(message->updateTimerSeconds, 3240U);
  EXPECT_EQ(message->cause, 18);
  EXPECT_EQ(message->imsVoice, true);
  EXPECT_EQ(message->emergencyBearers, true);
  EXPECT_EQ(message->tmsi, 0xD0000002);
  EXPECT_FALSE(message->guti);
}

TEST(EpsMobility, RejectsGiveTheirCause) {
  for (const auto& [dump, kind] : {std::pair("07 44 0b", Kind::attachReject), std::pair("07 4b 0f", Kind::updateReject),
                                   std::pair("07 4e 27", Kind::serviceReject)}) {
    const Bytes bytes = bytesOf(dump);
    const auto message = epsMobilityMessageOf(bytes);
    ASSERT_TRUE(message) << dump;
    EXPECT_EQ(message->kind, kind);
    EXPECT_EQ(message->cause, bytes[2]);
  }
}

TEST(EpsMobility, AServiceRequestHasAShortAndALongForm) {
  for (const char* dump : {"c7 11 9b d4", "07 4c 10 05 f4 00 00 00 01"}) {
    const Bytes bytes = bytesOf(dump);
    const auto message = epsMobilityMessageOf(bytes);
    ASSERT_TRUE(message) << dump;
    EXPECT_EQ(message->kind, Kind::serviceRequest);
  }
  EXPECT_FALSE(epsMobilityMessageOf(bytesOf("c7 11 9b")));
}

TEST(EpsMobility, OtherAndProtectedMessagesGiveNothing) {
  for (const char* dump : {"", "07", "07 52 00", "07 ff", "27 01 02 03 04 05 07 44 0b", "02 44 0b"}) {
    EXPECT_FALSE(epsMobilityMessageOf(bytesOf(dump))) << dump;
  }
}

TEST(EpsMobility, AMessageTruncatedInItsMandatoryPartGivesNothing) {
  const Bytes accept = bytesOf(literal::attachAccept);
  // Header, result, timer, areas and the session message with their lengths.
  constexpr std::size_t mandatory = 2 + 1 + 1 + 7 + 2 + 56;
  for (std::size_t length = 0; length <= accept.size(); ++length) {
    EXPECT_EQ(epsMobilityMessageOf(Span(accept).first(length)).has_value(), length >= mandatory) << length;
  }
}

TEST(EpsMobility, AnElementCutAtTheEndIsAbsent) {
  const Bytes accept = bytesOf(literal::updateAccept);
  const auto message = epsMobilityMessageOf(Span(accept).first(accept.size() - 1));
  ASSERT_TRUE(message);
  EXPECT_EQ(message->cause, 18);
  EXPECT_FALSE(message->imsVoice);
}

TEST(EpsMobility, ADamagedListOfAreasIsNoList) {
  EXPECT_TRUE(trackingAreasOf(bytesOf("01 62 f2 10 12 34 12")).empty());
  EXPECT_TRUE(trackingAreasOf(bytesOf("60 62 f2 10 12 34")).empty());
  EXPECT_TRUE(trackingAreasOf(bytesOf("00 ff ff ff 12 34")).empty());
  EXPECT_TRUE(trackingAreasOf({}).empty());
}

}  // namespace
}  // namespace vespscope::test
