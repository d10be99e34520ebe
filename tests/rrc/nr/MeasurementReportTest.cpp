// The levels in a phone's reports to an NR cell, read from literal bytes.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Messages.h"
#include "rrc/nr/MeasurementReport.h"

namespace vespscope::test {
namespace {

using namespace rrc::nr;
using ::testing::IsEmpty;

void expectServingCells(const std::optional<MeasurementReport>& report) {
  ASSERT_TRUE(report);
  EXPECT_EQ(report->measurement, 3);
  ASSERT_EQ(report->serving.size(), 2U);
  EXPECT_EQ(report->serving[0].index, 1);
  EXPECT_EQ(report->serving[0].cell.physicalCell, 1007);
  EXPECT_EQ(report->serving[0].cell.levels, (Levels{90, 70, 100}));
  ASSERT_TRUE(report->serving[0].neighbour);
  EXPECT_EQ(report->serving[0].neighbour->physicalCell, 2);
  EXPECT_EQ(report->serving[0].neighbour->levels, (Levels{60, 50, {}}));
  EXPECT_EQ(report->serving[1].index, 31);
  EXPECT_FALSE(report->serving[1].cell.physicalCell);
  EXPECT_EQ(report->serving[1].cell.levels, (Levels{1, {}, {}}));
  EXPECT_FALSE(report->serving[1].neighbour);
}

TEST(MeasurementReportOfNr, ReadsServingCellsAndNeighbours) {
  const ReadMessage message("nr-report");
  const auto report = measurementReportOf(*message);
  expectServingCells(report);
  ASSERT_EQ(report->nr.size(), 2U);
  EXPECT_EQ(report->nr[0].physicalCell, 500);
  EXPECT_EQ(report->nr[0].levels, (Levels{127, 0, 63}));
  EXPECT_EQ(report->nr[1].physicalCell, 0);
  EXPECT_THAT(report->lte, IsEmpty());
}

TEST(MeasurementReportOfNr, ReadsLteNeighbours) {
  const ReadMessage message("nr-report-lte");
  const auto report = measurementReportOf(*message);
  expectServingCells(report);
  EXPECT_THAT(report->nr, IsEmpty());
  ASSERT_EQ(report->lte.size(), 1U);
  EXPECT_EQ(report->lte[0].physicalCell, 503);
  EXPECT_EQ(report->lte[0].levels, (Levels{97, 34, 127}));
}

TEST(MeasurementReportOfNr, IsReadInsideATransferOfLte) {
  const ReadMessage message("nr-transfer");
  EXPECT_FALSE(measurementReportOf(*message));
  const rrc::View inner = message->content()["ul-DCCH-MessageNR-r15.message"].chosen();
  expectServingCells(measurementReportOf(inner));
}

}  // namespace
}  // namespace vespscope::test
