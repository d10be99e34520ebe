// The meaning of LTE RRC messages for the connection.
#include <gtest/gtest.h>

#include "Bytes.h"
#include "sources/diag/RrcMeaning.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;

std::optional<RrcMeaning> meaningOf(RrcChannel channel, std::string_view dump) {
  return rrcMeaningOf(channel, bytesOf(dump));
}

RrcMeaning told(RrcEvent event, std::optional<unsigned> cause = std::nullopt) { return {event, cause}; }

TEST(RrcMeaning, AConnectionRequestCarriesItsEstablishmentCause) {
  // c1 0, rrcConnectionRequest 1, release 8 form 0, S-TMSI 0, 40 bits, cause, spare
  EXPECT_EQ(meaningOf(RrcChannel::uplinkCcch, "40 00 00 00 00 00"), told(RrcEvent::connectionRequest, 0));
  EXPECT_EQ(meaningOf(RrcChannel::uplinkCcch, "40 00 00 00 00 02"), told(RrcEvent::connectionRequest, 1));
  EXPECT_EQ(meaningOf(RrcChannel::uplinkCcch, "4f ff ff ff ff f4"), told(RrcEvent::connectionRequest, 2));
  // A random value instead of the S-TMSI.
  EXPECT_EQ(meaningOf(RrcChannel::uplinkCcch, "5f ff ff ff ff f6"), told(RrcEvent::connectionRequest, 3));
  EXPECT_EQ(meaningOf(RrcChannel::uplinkCcch, "50 00 00 00 00 08"), told(RrcEvent::connectionRequest, 4));
  EXPECT_EQ(meaningOf(RrcChannel::uplinkCcch, "50 00 00 00 00 0d"), told(RrcEvent::connectionRequest, 6));
}

TEST(RrcMeaning, AConnectionRequestOfALaterReleaseHasNoCauseToRead) {
  EXPECT_EQ(meaningOf(RrcChannel::uplinkCcch, "60 00 00 00 00 08"), told(RrcEvent::connectionRequest));
}

TEST(RrcMeaning, AReestablishmentRequestCarriesItsOwnCause) {
  // c1 0, rrcConnectionReestablishmentRequest 0, release 8 form 0, 16 + 9 + 16 bits, cause, spare
  EXPECT_EQ(meaningOf(RrcChannel::uplinkCcch, "00 00 00 00 00 00"), told(RrcEvent::reestablishmentRequest, 0));
  EXPECT_EQ(meaningOf(RrcChannel::uplinkCcch, "1f ff ff ff ff f4"), told(RrcEvent::reestablishmentRequest, 1));
  EXPECT_EQ(meaningOf(RrcChannel::uplinkCcch, "00 00 00 00 00 08"), told(RrcEvent::reestablishmentRequest, 2));
  EXPECT_EQ(meaningOf(RrcChannel::uplinkCcch, "20 00 00 00 00 08"), told(RrcEvent::reestablishmentRequest));
}

TEST(RrcMeaning, OnTheDownlinkCcchOnlyTheRejectsHaveOne) {
  EXPECT_EQ(meaningOf(RrcChannel::downlinkCcch, "00"), std::nullopt);
  EXPECT_EQ(meaningOf(RrcChannel::downlinkCcch, "20"), told(RrcEvent::reestablishmentReject));
  EXPECT_EQ(meaningOf(RrcChannel::downlinkCcch, "40"), told(RrcEvent::connectionReject));
  EXPECT_EQ(meaningOf(RrcChannel::downlinkCcch, "70 12"), std::nullopt);
}

TEST(RrcMeaning, AReleaseCarriesItsCause) {
  // c1 0, rrcConnectionRelease 0101, transaction 2 bits, c1 0, release 8 form 00, three flags, cause
  EXPECT_EQ(meaningOf(RrcChannel::downlinkDcch, "28 00"), told(RrcEvent::connectionRelease, 0));
  EXPECT_EQ(meaningOf(RrcChannel::downlinkDcch, "2a 02"), told(RrcEvent::connectionRelease, 1));
  EXPECT_EQ(meaningOf(RrcChannel::downlinkDcch, "2e 3c"), told(RrcEvent::connectionRelease, 2));
  EXPECT_EQ(meaningOf(RrcChannel::downlinkDcch, "2a 06"), told(RrcEvent::connectionRelease, 3));
}

TEST(RrcMeaning, AReleaseInALaterFormHasNoCauseToRead) {
  EXPECT_EQ(meaningOf(RrcChannel::downlinkDcch, "29 02"), told(RrcEvent::connectionRelease));
  EXPECT_EQ(meaningOf(RrcChannel::downlinkDcch, "28 42"), told(RrcEvent::connectionRelease));
}

TEST(RrcMeaning, OtherMessagesOfTheDownlinkDcch) {
  EXPECT_EQ(meaningOf(RrcChannel::downlinkDcch, "1a"), told(RrcEvent::mobilityFromEutra));
  EXPECT_EQ(meaningOf(RrcChannel::downlinkDcch, "22 10"), told(RrcEvent::dedicatedMessage));
  EXPECT_EQ(meaningOf(RrcChannel::downlinkDcch, "08"), told(RrcEvent::dedicatedMessage));
}

TEST(RrcMeaning, MessagesOfTheUplinkDcch) {
  EXPECT_EQ(meaningOf(RrcChannel::uplinkDcch, "24 00"), told(RrcEvent::connectionSetupComplete));
  EXPECT_EQ(meaningOf(RrcChannel::uplinkDcch, "1a 00"), told(RrcEvent::reestablishmentComplete));
  EXPECT_EQ(meaningOf(RrcChannel::uplinkDcch, "08 10"), told(RrcEvent::dedicatedMessage));
  EXPECT_EQ(meaningOf(RrcChannel::uplinkDcch, "12 00"), told(RrcEvent::reconfigurationComplete));
}

TEST(RrcMeaning, OfTheBranchOfLaterReleasesAResumeCounts) {
  // messageClassExtension 1, c2 0, rrcConnectionResumeComplete 0100
  EXPECT_EQ(meaningOf(RrcChannel::uplinkDcch, "90 00"), told(RrcEvent::connectionSetupComplete));
  EXPECT_EQ(meaningOf(RrcChannel::uplinkDcch, "8c 00"), std::nullopt);
  EXPECT_EQ(meaningOf(RrcChannel::uplinkDcch, "d0 00"), std::nullopt);  // an even later release
  // messageClassExtension 1, c2 0: the resume request is the only choice
  EXPECT_EQ(meaningOf(RrcChannel::uplinkCcch, "80 00"), told(RrcEvent::connectionRequest));
  for (const RrcChannel channel :
       {RrcChannel::downlinkCcch, RrcChannel::downlinkDcch, RrcChannel::uplinkCcch, RrcChannel::uplinkDcch}) {
    EXPECT_EQ(meaningOf(channel, "ea 02 00 00 00 00"), std::nullopt);
    EXPECT_EQ(meaningOf(channel, ""), std::nullopt);
  }
}

TEST(RrcMeaning, BroadcastAndPagingHaveNone) {
  EXPECT_EQ(meaningOf(RrcChannel::other, "40 00 00 00 00 08"), std::nullopt);
}

TEST(RrcMeaning, AMessageCutBeforeItsCauseHasNone) {
  EXPECT_EQ(meaningOf(RrcChannel::uplinkCcch, "40 00 00 00 00"), told(RrcEvent::connectionRequest));
  EXPECT_EQ(meaningOf(RrcChannel::downlinkDcch, "2a"), told(RrcEvent::connectionRelease));
}

}  // namespace
}  // namespace vespscope::test
