// The information that a cell broadcasts about itself, read from literal bytes.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Messages.h"
#include "rrc/lte/CellInformation.h"

namespace vespscope::test {
namespace {

using namespace rrc::lte;
using ::testing::ElementsAre;

TEST(CellInformation, ReadsTheMasterInformationBlock) {
  const ReadMessage message("mib");
  const auto block = masterInformationOf(*message);
  ASSERT_TRUE(block);
  EXPECT_EQ(block->bandwidth, 50);
  EXPECT_TRUE(block->extendedPhich);
  EXPECT_EQ(block->phichResource, "half");
  EXPECT_EQ(block->frameNumber, 0xA5);
  EXPECT_FALSE(cellInformationOf(*message));
}

TEST(CellInformation, ReadsNetworksAndIdentitiesOfBlockOne) {
  const ReadMessage message("sib1");
  const auto cell = cellInformationOf(*message);
  ASSERT_TRUE(cell);
  ASSERT_EQ(cell->networks.size(), 2U);
  EXPECT_EQ(cell->networks[0].plmn, (Plmn{1, 1, 2}));
  EXPECT_FALSE(cell->networks[0].reserved);
  // The second entry omits the country.
  EXPECT_EQ(cell->networks[1].plmn, (Plmn{1, 20, 3}));
  EXPECT_TRUE(cell->networks[1].reserved);
  EXPECT_EQ(cell->trackingAreaCode, 0x1234);
  EXPECT_EQ(cell->cellIdentity, 0xABCDE01U);
  EXPECT_TRUE(cell->barred);
  EXPECT_FALSE(cell->intraFrequencyReselection);
  EXPECT_EQ(cell->csgIdentity, 0x5A5A5A5U);
}

TEST(CellInformation, ReadsSelectionBandsAndScheduleOfBlockOne) {
  const ReadMessage message("sib1");
  const auto cell = cellInformationOf(*message);
  ASSERT_TRUE(cell);
  EXPECT_EQ(cell->qRxLevMin, -64);
  EXPECT_EQ(cell->qRxLevMinOffset, 3);
  EXPECT_EQ(cell->qQualMin, -20);
  EXPECT_EQ(cell->maximumPower, 23);
  // The 6-bit numbers are 64, which refers to the extension.
  EXPECT_EQ(cell->band, 66);
  EXPECT_THAT(cell->moreBands, ElementsAre(85, 7));
  ASSERT_EQ(cell->schedule.size(), 2U);
  EXPECT_EQ(cell->schedule[0].period, 16);
  EXPECT_THAT(cell->schedule[0].blocks, ElementsAre("sibType3"));
  EXPECT_EQ(cell->schedule[1].period, 32);
  EXPECT_THAT(cell->schedule[1].blocks, ElementsAre("sibType5", "sibType6", "sibType24-v1530"));
  ASSERT_TRUE(cell->tdd);
  EXPECT_EQ(cell->tdd->subframeAssignment, 2);
  EXPECT_EQ(cell->tdd->specialSubframePattern, 7);
  EXPECT_EQ(cell->windowLength, 20);
  EXPECT_EQ(cell->valueTag, 17);
}

}  // namespace
}  // namespace vespscope::test
