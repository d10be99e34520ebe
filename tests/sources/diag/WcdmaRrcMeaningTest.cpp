// What UMTS RRC messages of literal bytes say about the connection.
#include <gtest/gtest.h>

#include "Bytes.h"
#include "sources/diag/WcdmaRrcMeaning.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;
using Channel = WcdmaChannel;
using Event = WcdmaRrcEvent;

std::optional<WcdmaRrcMeaning> meaningOf(Channel channel, std::string_view dump) {
  return wcdmaRrcMeaningOf(channel, bytesOf(dump));
}

TEST(WcdmaRrcMeaning, ARequestGivesItsCauseAfterTheIdentity) {
  // A TMSI with a network code of three digits, cause 13.
  EXPECT_EQ(meaningOf(Channel::uplinkCcch, "39 00 00 00 01 31 09 30 0d f4 b5 24")->cause, 13U);
  // An IMSI of 15 digits, cause 12.
  EXPECT_EQ(meaningOf(Channel::uplinkCcch, "20 93 10 26 00 12 34 56 78 60")->event, Event::connectionRequest);
  EXPECT_EQ(meaningOf(Channel::uplinkCcch, "20 93 10 26 00 12 34 56 78 60")->cause, 12U);
  // Truncated in the identity.
  EXPECT_FALSE(meaningOf(Channel::uplinkCcch, "39 00 00")->cause);
}

TEST(WcdmaRrcMeaning, ASetupGivesTheRequestedState) {
  // Release 99 without any optional part, an IMEI, CELL_FACH.
  const auto first = meaningOf(Channel::downlinkCcch, "30 00 60 00 00 00 00 00 00 00 7f ff ff ff a0");
  ASSERT_TRUE(first);
  EXPECT_EQ(first->event, Event::connectionSetup);
  EXPECT_EQ(first->state, 1U);
}

TEST(WcdmaRrcMeaning, ReleaseAndRejectGiveTheirCauses) {
  // Release 4's form with the number of answers, normal event.
  EXPECT_EQ(meaningOf(Channel::downlinkDcch, "3e 31 0c 00")->event, Event::connectionRelease);
  EXPECT_EQ(meaningOf(Channel::downlinkDcch, "3e 31 0c 00")->cause, 0U);
  // Release 99's form without it, user inactivity.
  EXPECT_EQ(meaningOf(Channel::downlinkDcch, "3c 0c")->cause, 6U);
  // An IMEI, unspecified; and the same with a redirection.
  const auto reject = meaningOf(Channel::downlinkCcch, "10 c0 00 00 00 00 00 00 00 80");
  ASSERT_TRUE(reject);
  EXPECT_EQ(reject->event, Event::connectionReject);
  EXPECT_EQ(reject->cause, 1U);
  EXPECT_FALSE(reject->redirected);
  EXPECT_TRUE(meaningOf(Channel::downlinkCcch, "12 c0 00 00 00 00 00 00 00 80")->redirected);
}

TEST(WcdmaRrcMeaning, ACellUpdateSaysWhetherTheRadioLinkFailed) {
  EXPECT_EQ(meaningOf(Channel::uplinkCcch, "03 ff ff ff fc 00 00 00 40")->event, Event::cellUpdate);
  EXPECT_EQ(meaningOf(Channel::uplinkCcch, "03 ff ff ff fc 00 00 01 40")->event, Event::radioLinkFailure);
  EXPECT_FALSE(meaningOf(Channel::uplinkCcch, "03 ff ff ff fc"));
}

TEST(WcdmaRrcMeaning, IntegrityProtectionIsSkipped) {
  EXPECT_EQ(meaningOf(Channel::uplinkDcch, "44 00")->event, Event::connectionReleaseComplete);
  EXPECT_EQ(meaningOf(Channel::uplinkDcch, "ff ff ff ff f4 40")->event, Event::connectionReleaseComplete);
}

TEST(WcdmaRrcMeaning, DirectTransfersCarryTheirMessage) {
  const auto downlink = meaningOf(Channel::downlinkDcch, "14 20 04 10 08 16");
  ASSERT_TRUE(downlink);
  EXPECT_EQ(downlink->event, Event::directTransfer);
  EXPECT_EQ(downlink->nasMessage, bytesOf("08 04 0b"));
  EXPECT_FALSE(meaningOf(Channel::downlinkDcch, "14 20 04 10 08"));
  const auto uplink = meaningOf(Channel::uplinkDcch, "6c 00 08 28 58");
  ASSERT_TRUE(uplink);
  EXPECT_EQ(uplink->nasMessage, bytesOf("05 0b"));
  const auto initial = meaningOf(Channel::uplinkDcch, "14 80 00 00 08 40 a8");
  ASSERT_TRUE(initial);
  EXPECT_EQ(initial->nasMessage, bytesOf("08 15"));
}

TEST(WcdmaRrcMeaning, OtherMessagesHaveNone) {
  EXPECT_FALSE(meaningOf(Channel::uplinkDcch, ""));
  EXPECT_FALSE(meaningOf(Channel::uplinkDcch, "20"));
  EXPECT_FALSE(meaningOf(Channel::downlinkDcch, "22 4e"));
  EXPECT_FALSE(meaningOf(Channel::downlinkCcch, "70"));
  EXPECT_FALSE(meaningOf(Channel::uplinkCcch, "60"));
  EXPECT_FALSE(meaningOf(Channel::uplinkDcch, "ff ff"));
}

}  // namespace
}  // namespace vespscope::test
