// System information blocks 2, 3, 5, 6 and 7, read from literal bytes.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Messages.h"
#include "rrc/lte/Reselection.h"

namespace vespscope::test {
namespace {

using namespace rrc::lte;
using ::testing::ElementsAre;

TEST(SystemInformation, ReadsBarringAndTheUplinkOfBlockTwo) {
  const ReadMessage message("sib2");
  const auto information = systemInformationOf(*message);
  ASSERT_TRUE(information && information->access);
  const AccessInformation& access = *information->access;
  EXPECT_TRUE(access.emergencyBarred);
  ASSERT_TRUE(access.signalling);
  EXPECT_EQ(access.signalling->factor, 5);
  EXPECT_EQ(access.signalling->time, 512);
  EXPECT_EQ(access.signalling->specialClasses, 0b00001);
  ASSERT_TRUE(access.data);
  EXPECT_EQ(access.data->factor, 75);
  EXPECT_EQ(access.data->time, 64);
  EXPECT_EQ(access.data->specialClasses, 0b10010);
  ASSERT_TRUE(access.csFallback);
  EXPECT_EQ(access.csFallback->factor, 75);
  EXPECT_EQ(access.uplinkCarrier, 19300);
  EXPECT_EQ(access.uplinkBandwidth, 75);
  EXPECT_FALSE(information->serving);
}

TEST(SystemInformation, ReadsTheServingFrequencyOfBlockThree) {
  const ReadMessage message("si");
  const auto information = systemInformationOf(*message);
  ASSERT_TRUE(information && information->serving);
  const ServingReselection& serving = *information->serving;
  EXPECT_EQ(serving.hysteresis, 4);
  EXPECT_EQ(serving.sNonIntraSearch, 9);
  EXPECT_EQ(serving.threshServingLow, 5);
  EXPECT_EQ(serving.threshServingLowQ, 4);
  EXPECT_EQ(serving.priority, 6);
  EXPECT_EQ(serving.qRxLevMin, -62);
  EXPECT_EQ(serving.qQualMin, -18);
  EXPECT_EQ(serving.maximumPower, 23);
  EXPECT_EQ(serving.sIntraSearch, 29);
  EXPECT_EQ(serving.sIntraSearchP, 30);
  EXPECT_EQ(serving.sIntraSearchQ, 11);
  EXPECT_EQ(serving.sNonIntraSearchP, 8);
  EXPECT_EQ(serving.sNonIntraSearchQ, 7);
  EXPECT_EQ(serving.measuredBandwidth, 50);
  EXPECT_TRUE(serving.antennaPort1);
  EXPECT_EQ(serving.neighbourConfiguration, 1);
  EXPECT_EQ(serving.reselectionTime, 2);
}

TEST(SystemInformation, ReadsTheFrequenciesOfBlockFive) {
  const ReadMessage message("si");
  const auto information = systemInformationOf(*message);
  ASSERT_TRUE(information && information->lte);
  ASSERT_EQ(information->lte->size(), 3U);
  const LteNeighbourFrequency& first = information->lte->at(0);
  EXPECT_EQ(first.carrier, 1300U);
  EXPECT_EQ(first.qRxLevMin, -60);
  EXPECT_EQ(first.qQualMin, -19);
  EXPECT_EQ(first.maximumPower, 20);
  EXPECT_EQ(first.reselectionTime, 1);
  EXPECT_EQ(first.threshXHigh, 11);
  EXPECT_EQ(first.threshXLow, 12);
  EXPECT_EQ(first.threshXHighQ, 13);
  EXPECT_EQ(first.threshXLowQ, 14);
  EXPECT_EQ(first.measuredBandwidth, 100);
  EXPECT_FALSE(first.antennaPort1);
  EXPECT_EQ(first.priority, 7);
  EXPECT_EQ(first.neighbourConfiguration, 2);
  EXPECT_EQ(first.offset, -3);
  ASSERT_EQ(first.cells.size(), 2U);
  EXPECT_EQ(first.cells[0].physicalCell, 101);
  EXPECT_EQ(first.cells[0].offset, -24);
  EXPECT_EQ(first.cells[1].physicalCell, 503);
  EXPECT_EQ(first.cells[1].offset, 5);
  EXPECT_THAT(first.excludedCells, ElementsAre(CellRange{20, 8}, CellRange{400, 1}));
}

TEST(SystemInformation, ReadsChannelsAbove65535OfBlockFive) {
  const ReadMessage message("si");
  const auto information = systemInformationOf(*message);
  ASSERT_TRUE(information && information->lte);
  ASSERT_EQ(information->lte->size(), 3U);
  // The second entry's 16-bit number refers to the late extension; the third entry is in the list of release 12.
  const LteNeighbourFrequency& second = information->lte->at(1);
  EXPECT_EQ(second.carrier, 66486U);
  EXPECT_EQ(second.threshXLow, 31);
  EXPECT_EQ(second.offset, 0);
  EXPECT_FALSE(second.priority);
  const LteNeighbourFrequency& third = information->lte->at(2);
  EXPECT_EQ(third.carrier, 67000U);
  EXPECT_EQ(third.qRxLevMin, -61);
  EXPECT_EQ(third.measuredBandwidth, 25);
  EXPECT_EQ(third.priority, 1);
  EXPECT_EQ(third.neighbourConfiguration, 3);
  EXPECT_EQ(third.offset, 2);
}

TEST(SystemInformation, ReadsTheFrequenciesOfBlockSix) {
  const ReadMessage message("si67");
  const auto information = systemInformationOf(*message);
  ASSERT_TRUE(information && information->umts);
  EXPECT_EQ(information->umtsReselectionTime, 5);
  ASSERT_EQ(information->umts->size(), 2U);
  const UmtsNeighbourFrequency& first = information->umts->at(0);
  EXPECT_FALSE(first.tdd);
  EXPECT_EQ(first.carrier, 10588);
  EXPECT_EQ(first.priority, 2);
  EXPECT_EQ(first.threshXHigh, 6);
  EXPECT_EQ(first.threshXLow, 4);
  EXPECT_EQ(first.qRxLevMin, -58);
  EXPECT_EQ(first.maximumPower, 33);
  EXPECT_EQ(first.qQualMin, -18);
  const UmtsNeighbourFrequency& second = information->umts->at(1);
  EXPECT_TRUE(second.tdd);
  EXPECT_EQ(second.carrier, 9404);
  EXPECT_FALSE(second.priority);
  EXPECT_EQ(second.maximumPower, -50);
  EXPECT_FALSE(second.qQualMin);
}

TEST(SystemInformation, ReadsTheFrequenciesOfBlockSeven) {
  const ReadMessage message("si67");
  const auto information = systemInformationOf(*message);
  ASSERT_TRUE(information && information->gsm);
  EXPECT_EQ(information->gsmReselectionTime, 4);
  ASSERT_EQ(information->gsm->size(), 3U);
  const GsmNeighbourFrequencies& listed = information->gsm->at(0);
  EXPECT_TRUE(listed.carriers.band1900);
  EXPECT_THAT(listed.carriers.channels, ElementsAre(514, 516, 1023));
  EXPECT_EQ(listed.priority, 0);
  EXPECT_EQ(listed.permittedColourCodes, 0b11001000);
  EXPECT_EQ(listed.qRxLevMin, 7);
  EXPECT_EQ(listed.maximumPower, 33);
  EXPECT_EQ(listed.threshXHigh, 10);
  EXPECT_EQ(listed.threshXLow, 9);
  // Channels continue from 1023 to 0.
  const GsmNeighbourFrequencies& spaced = information->gsm->at(1);
  EXPECT_FALSE(spaced.carriers.band1900);
  EXPECT_THAT(spaced.carriers.channels, ElementsAre(1020, 1022, 0, 2));
  EXPECT_FALSE(spaced.maximumPower);
  EXPECT_THAT(information->gsm->at(2).carriers.channels, ElementsAre(10, 11, 18, 20));
}

}  // namespace
}  // namespace vespscope::test
