// The messages that open, maintain and secure a connection, read from literal bytes.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Messages.h"
#include "rrc/lte/Connection.h"

namespace vespscope::test {
namespace {

using namespace rrc::lte;
using ::testing::ElementsAre;
using ::testing::Optional;

TEST(ConnectionRequest, StatesCauseAndKindOfIdentity) {
  const ReadMessage random("request");
  const auto first = connectionRequestOf(*random);
  ASSERT_TRUE(first);
  EXPECT_EQ(first->cause, "mo-VoiceCall-v1280");
  EXPECT_FALSE(first->temporaryIdentity);
  const ReadMessage registered("request-tmsi");
  const auto second = connectionRequestOf(*registered);
  ASSERT_TRUE(second);
  EXPECT_EQ(second->cause, "mt-Access");
  EXPECT_TRUE(second->temporaryIdentity);
  EXPECT_FALSE(reestablishmentRequestOf(*registered));
}

TEST(ConnectionReject, StatesTheWaitTime) {
  const ReadMessage message("reject");
  const auto reject = connectionRejectOf(*message);
  ASSERT_TRUE(reject);
  EXPECT_EQ(reject->waitTime, 16);
}

TEST(ConnectionSetupComplete, HoldsTheFirstNasMessage) {
  const ReadMessage message("setup-complete");
  const auto complete = connectionSetupCompleteOf(*message);
  ASSERT_TRUE(complete);
  EXPECT_EQ(complete->selectedNetwork, 2);
  EXPECT_THAT(complete->nas, ElementsAre(0x07, 0x60, 0x16));
}

TEST(ConnectionReestablishmentRequest, StatesTheFormerCellAndTheCause) {
  const ReadMessage message("reestablishment-request");
  const auto request = reestablishmentRequestOf(*message);
  ASSERT_TRUE(request);
  EXPECT_EQ(request->cRnti, 0x4601);
  EXPECT_EQ(request->physicalCell, 333);
  EXPECT_EQ(request->cause, "handoverFailure");
  EXPECT_FALSE(connectionRequestOf(*message));
}

TEST(ConnectionSecurityMode, NamesTheAlgorithms) {
  const ReadMessage message("security");
  const auto mode = securityModeOf(*message);
  ASSERT_TRUE(mode);
  EXPECT_EQ(mode->ciphering, "eea0");
  EXPECT_EQ(mode->integrity, "eia2");
}

TEST(ConnectionMobilityFromLte, NamesPurposeAndTechnology) {
  const ReadMessage handover("mobility");
  const auto first = mobilityFromLteOf(*handover);
  ASSERT_TRUE(first);
  EXPECT_TRUE(first->csFallback);
  EXPECT_EQ(first->purpose, "handover");
  EXPECT_EQ(first->technology, "cdma2000-HRPD");
  const ReadMessage order("mobility-geran");
  const auto second = mobilityFromLteOf(*order);
  ASSERT_TRUE(second);
  EXPECT_FALSE(second->csFallback);
  EXPECT_EQ(second->purpose, "cellChangeOrder");
  EXPECT_EQ(second->technology, "geran");
}

TEST(ConnectionPaging, CountsRecordsAndStatesChanges) {
  const ReadMessage message("paging");
  const auto paging = pagingOf(*message);
  ASSERT_TRUE(paging);
  EXPECT_EQ(paging->records, 2);
  EXPECT_TRUE(paging->systemInformationChange);
  EXPECT_FALSE(paging->earthquakeWarning);
  EXPECT_TRUE(paging->mobileAlert);
}

TEST(ConnectionInformationTransfer, HoldsANasMessage) {
  const ReadMessage down("dl-transfer");
  EXPECT_THAT(transferredNasOf(*down), Optional(ElementsAre(0x07, 0x60, 0x16)));
  const ReadMessage up("ul-transfer");
  EXPECT_THAT(transferredNasOf(*up), Optional(ElementsAre(0x07, 0x60, 0x16)));
  const ReadMessage other("paging");
  EXPECT_FALSE(transferredNasOf(*other));
}

}  // namespace
}  // namespace vespscope::test
