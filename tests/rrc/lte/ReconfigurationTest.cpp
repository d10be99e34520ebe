// The network's configuration of a connected phone, read from literal bytes.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Messages.h"
#include "rrc/lte/Reconfiguration.h"

namespace vespscope::test {
namespace {

using namespace rrc::lte;
using ::testing::ElementsAre;
using ::testing::IsEmpty;
using Drx = Reconfiguration::Drx;
using Technology = MeasurementObject::Technology;

const DiscontinuousReception reception{10, 200, 16, 320, 123, DiscontinuousReception::ShortCycle{40, 3}};

TEST(Reconfiguration, ReadsDiscontinuousReception) {
  const ReadMessage message("recon-drx");
  const auto result = reconfigurationOf(*message);
  ASSERT_TRUE(result);
  EXPECT_EQ(result->drx, Drx::set);
  EXPECT_EQ(result->drxSetting, reception);
  EXPECT_THAT(result->nas, ElementsAre(ElementsAre(0x07, 0x60, 0x16)));
  EXPECT_FALSE(result->mobility);
  EXPECT_FALSE(result->measurements);
  EXPECT_FALSE(result->nrReleased);
  EXPECT_FALSE(result->nrConfiguration);
}

TEST(Reconfiguration, PrefersTheValuesOfLaterReleases) {
  const ReadMessage message("recon-drx-v1130");
  const auto result = reconfigurationOf(*message);
  ASSERT_TRUE(result);
  EXPECT_EQ(result->drxSetting, (DiscontinuousReception{10, 200, 0, 70, 69, DiscontinuousReception::ShortCycle{4, 3}}));
}

TEST(Reconfiguration, DistinguishesReleasedFromUnchangedReception) {
  const ReadMessage released("recon-drx-release");
  EXPECT_EQ(reconfigurationOf(*released)->drx, Drx::released);
  const ReadMessage usual("recon-default-mac");
  EXPECT_EQ(reconfigurationOf(*usual)->drx, Drx::released);
  const ReadMessage handover("recon-handover");
  EXPECT_EQ(reconfigurationOf(*handover)->drx, Drx::unchanged);
}

TEST(Reconfiguration, ReadsSecondaryCellsOfSeveralReleases) {
  const ReadMessage message("recon-drx");
  const auto result = reconfigurationOf(*message);
  ASSERT_TRUE(result);
  EXPECT_THAT(result->releasedCells, ElementsAre(4, 7));
  ASSERT_EQ(result->addedCells.size(), 3U);
  const SecondaryCell& first = result->addedCells[0];
  EXPECT_EQ(first.index, 1);
  EXPECT_EQ(first.physicalCell, 300);
  EXPECT_EQ(first.downlinkCarrier, 1300U);
  EXPECT_EQ(first.bandwidth, 100);
  EXPECT_FALSE(first.uplink);
  const SecondaryCell& second = result->addedCells[1];
  EXPECT_EQ(second.index, 2);
  EXPECT_EQ(second.physicalCell, 77);
  EXPECT_EQ(second.downlinkCarrier, 66536U);
  EXPECT_EQ(second.bandwidth, 50);
  const SecondaryCell& third = result->addedCells[2];
  EXPECT_EQ(third.index, 31);
  EXPECT_EQ(third.physicalCell, 9);
  EXPECT_EQ(third.downlinkCarrier, 255144U);
  EXPECT_FALSE(third.bandwidth);
}

TEST(Reconfiguration, ReadsAHandover) {
  const ReadMessage message("recon-handover");
  const auto result = reconfigurationOf(*message);
  ASSERT_TRUE(result && result->mobility);
  EXPECT_EQ(result->mobility->physicalCell, 455);
  EXPECT_EQ(result->mobility->downlinkCarrier, 2850U);
  EXPECT_EQ(result->mobility->uplinkCarrier, 20850U);
  EXPECT_EQ(result->mobility->downlinkBandwidth, 100);
  EXPECT_EQ(result->mobility->uplinkBandwidth, 75);
  EXPECT_EQ(result->mobility->t304, 500);
  EXPECT_EQ(result->mobility->cRnti, 0xBEEF);
}

TEST(Reconfiguration, ReadsMeasurementObjects) {
  const ReadMessage message("recon-handover");
  const auto result = reconfigurationOf(*message);
  ASSERT_TRUE(result && result->measurements);
  const MeasurementConfiguration& measurements = *result->measurements;
  EXPECT_THAT(measurements.removedObjects, ElementsAre(5));
  ASSERT_EQ(measurements.objects.size(), 4U);
  const MeasurementObject& lte = measurements.objects[0];
  EXPECT_EQ(lte.id, 1);
  EXPECT_EQ(lte.technology, Technology::lte);
  EXPECT_EQ(lte.carrier, 66486U);
  EXPECT_EQ(lte.bandwidth, 25);
  EXPECT_EQ(lte.offset, -2);
  EXPECT_EQ(lte.cellToIdentify, 12);
  ASSERT_EQ(lte.cells.size(), 1U);
  EXPECT_EQ(lte.cells[0].index, 1);
  EXPECT_EQ(lte.cells[0].physicalCell, 44);
  EXPECT_EQ(lte.cells[0].offset, 6);
  EXPECT_EQ(measurements.objects[1].technology, Technology::umts);
  EXPECT_EQ(measurements.objects[1].carrier, 10588U);
  EXPECT_EQ(measurements.objects[1].offset, -15);
  EXPECT_EQ(measurements.objects[2].technology, Technology::gsm);
  ASSERT_TRUE(measurements.objects[2].gsmCarriers);
  EXPECT_THAT(measurements.objects[2].gsmCarriers->channels, ElementsAre(60, 70));
  EXPECT_EQ(measurements.objects[3].technology, Technology::nr);
  EXPECT_EQ(measurements.objects[3].carrier, 641280U);
  EXPECT_EQ(measurements.objects[3].offset, 4);
}

TEST(Reconfiguration, ReadsReportConfigurations) {
  const ReadMessage message("recon-handover");
  const auto result = reconfigurationOf(*message);
  ASSERT_TRUE(result && result->measurements);
  const MeasurementConfiguration& measurements = *result->measurements;
  EXPECT_THAT(measurements.removedReports, ElementsAre(9));
  ASSERT_EQ(measurements.reports.size(), 4U);
  const ReportConfiguration& a3 = measurements.reports[0];
  EXPECT_EQ(a3.trigger, "eventA3");
  EXPECT_EQ(a3.offset, -6);
  EXPECT_EQ(a3.hysteresis, 2);
  EXPECT_EQ(a3.timeToTrigger, 640);
  EXPECT_EQ(a3.triggerQuantity, "rsrp");
  EXPECT_EQ(a3.maximumCells, 8);
  EXPECT_EQ(a3.interval, 240U);
  EXPECT_FALSE(a3.amount);
  EXPECT_THAT(a3.thresholds, IsEmpty());
  const ReportConfiguration& a5 = measurements.reports[1];
  EXPECT_EQ(a5.trigger, "eventA5");
  ASSERT_EQ(a5.thresholds.size(), 2U);
  EXPECT_EQ(a5.thresholds[0].quantity, "threshold-RSRP");
  EXPECT_EQ(a5.thresholds[0].code, 30);
  EXPECT_EQ(a5.thresholds[1].quantity, "threshold-RSRQ");
  EXPECT_EQ(a5.thresholds[1].code, 20);
  EXPECT_EQ(a5.interval, 360'000U);
  EXPECT_EQ(a5.amount, 4);
  const ReportConfiguration& b2 = measurements.reports[2];
  EXPECT_TRUE(b2.interTechnology);
  EXPECT_EQ(b2.trigger, "eventB2");
  ASSERT_EQ(b2.thresholds.size(), 2U);
  EXPECT_EQ(b2.thresholds[1].quantity, "utra-RSCP");
  EXPECT_EQ(b2.thresholds[1].code, -5);
  const ReportConfiguration& periodical = measurements.reports[3];
  EXPECT_EQ(periodical.trigger, "periodical");
  EXPECT_EQ(periodical.purpose, "reportCGI");
  EXPECT_FALSE(periodical.timeToTrigger);
}

TEST(Reconfiguration, ReadsMeasurementIdentities) {
  const ReadMessage message("recon-handover");
  const auto result = reconfigurationOf(*message);
  ASSERT_TRUE(result && result->measurements);
  const MeasurementConfiguration& measurements = *result->measurements;
  EXPECT_THAT(measurements.removedIdentities, ElementsAre(32));
  ASSERT_EQ(measurements.identities.size(), 3U);
  EXPECT_EQ(measurements.identities[0].id, 1);
  EXPECT_EQ(measurements.identities[0].object, 1);
  EXPECT_EQ(measurements.identities[0].report, 2);
  EXPECT_EQ(measurements.identities[1].object, 4);
  EXPECT_EQ(measurements.identities[2].id, 33);
  EXPECT_EQ(measurements.identities[2].object, 3);
  EXPECT_EQ(measurements.identities[2].report, 4);
  EXPECT_EQ(measurements.sMeasure, 97);
}

TEST(Reconfiguration, ReadsTheReceptionOfASetup) {
  const ReadMessage message("setup");
  const auto setup = connectionSetupOf(*message);
  ASSERT_TRUE(setup);
  EXPECT_EQ(setup->drxSetting, reception);
  EXPECT_FALSE(reconfigurationOf(*message));
  EXPECT_FALSE(reestablishmentOf(*message));
}

}  // namespace
}  // namespace vespscope::test
