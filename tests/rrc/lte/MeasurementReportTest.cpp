// The levels in a phone's reports, read from literal bytes.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Messages.h"
#include "rrc/lte/MeasurementReport.h"

namespace vespscope::test {
namespace {

using namespace rrc::lte;
using ::testing::IsEmpty;

TEST(MeasurementReport, ReadsServingCells) {
  const ReadMessage message("report-lte");
  const auto report = measurementReportOf(*message);
  ASSERT_TRUE(report);
  EXPECT_EQ(report->measurement, 40);  // the later, larger form
  EXPECT_EQ(report->primary, (Levels{47, 21, 99}));
  ASSERT_EQ(report->serving.size(), 1U);
  EXPECT_EQ(report->serving[0].index, 1);
  EXPECT_EQ(report->serving[0].cell, (Levels{33, 12, 60}));
  ASSERT_TRUE(report->serving[0].neighbour);
  EXPECT_EQ(report->serving[0].neighbour->physicalCell, 7);
  EXPECT_EQ(report->serving[0].neighbour->levels, (Levels{3, 2, {}}));
  ASSERT_EQ(report->nrServing.size(), 1U);
  EXPECT_EQ(report->nrServing[0].carrier, 641280U);
  ASSERT_TRUE(report->nrServing[0].cell);
  EXPECT_EQ(report->nrServing[0].cell->physicalCell, 1007);
  EXPECT_EQ(report->nrServing[0].cell->levels.rsrp, 70);
  EXPECT_EQ(report->nrServing[0].cell->levels.rsrq, 65);
  EXPECT_EQ(report->nrServing[0].cell->levels.sinr, 80);
  ASSERT_TRUE(report->nrServing[0].neighbour);
  EXPECT_EQ(report->nrServing[0].neighbour->physicalCell, 3);
  EXPECT_FALSE(report->nrServing[0].neighbour->levels.rsrq);
}

TEST(MeasurementReport, ReadsLteNeighbours) {
  const ReadMessage message("report-lte");
  const auto report = measurementReportOf(*message);
  ASSERT_TRUE(report);
  ASSERT_EQ(report->lte.size(), 2U);
  EXPECT_EQ(report->lte[0].physicalCell, 121);
  EXPECT_EQ(report->lte[0].levels, (Levels{50, {}, {}}));
  EXPECT_FALSE(report->lte[0].cellIdentity);
  EXPECT_EQ(report->lte[1].physicalCell, 503);
  EXPECT_EQ(report->lte[1].levels, (Levels{97, 34, 127}));
  EXPECT_EQ(report->lte[1].plmn, (Plmn{1, 1, 2}));
  EXPECT_EQ(report->lte[1].cellIdentity, 0x0102030U);
  EXPECT_EQ(report->lte[1].trackingAreaCode, 0xFFFE);
  EXPECT_THAT(report->umts, IsEmpty());
  EXPECT_THAT(report->gsm, IsEmpty());
  EXPECT_THAT(report->nr, IsEmpty());
}

TEST(MeasurementReport, ReadsUmtsNeighbours) {
  const ReadMessage message("report-umts");
  const auto report = measurementReportOf(*message);
  ASSERT_TRUE(report);
  ASSERT_EQ(report->umts.size(), 2U);
  EXPECT_FALSE(report->umts[0].tdd);
  EXPECT_EQ(report->umts[0].scramblingCode, 511);
  EXPECT_EQ(report->umts[0].rscp, -5);
  EXPECT_EQ(report->umts[0].ecNo, 49);
  EXPECT_TRUE(report->umts[1].tdd);
  EXPECT_EQ(report->umts[1].scramblingCode, 127);
  EXPECT_EQ(report->umts[1].rscp, 91);
  EXPECT_FALSE(report->umts[1].ecNo);
}

TEST(MeasurementReport, ReadsGsmNeighbours) {
  const ReadMessage message("report-gsm");
  const auto report = measurementReportOf(*message);
  ASSERT_TRUE(report);
  ASSERT_EQ(report->gsm.size(), 1U);
  EXPECT_EQ(report->gsm[0].channel, 661);
  EXPECT_TRUE(report->gsm[0].band1900);
  EXPECT_EQ(report->gsm[0].identityCode, 5 * 8 + 3);
  EXPECT_EQ(report->gsm[0].rxlev, 63);
}

TEST(MeasurementReport, ReadsNrNeighbours) {
  const ReadMessage message("report-nr");
  const auto report = measurementReportOf(*message);
  ASSERT_TRUE(report);
  ASSERT_EQ(report->nr.size(), 1U);
  EXPECT_EQ(report->nr[0].physicalCell, 501);
  EXPECT_EQ(report->nr[0].levels.rsrp, 127);
  EXPECT_EQ(report->nr[0].levels.rsrq, 0);
  EXPECT_FALSE(report->nr[0].levels.sinr);
}

}  // namespace
}  // namespace vespscope::test
