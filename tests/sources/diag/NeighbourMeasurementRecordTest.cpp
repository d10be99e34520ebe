// LTE measurements of neighbour cells, of literal bytes.
#include <gtest/gtest.h>

#include "Bytes.h"
#include "Faults.h"
#include "LiteralRecords.h"
#include "sources/diag/LteRecords.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;

TEST(NeighbourMeasurementRecord, NeighboursAreReadAndDetectedCellsCounted) {
  const auto record = std::get<NeighbourMeasurementRecord>(neighbourMeasurementOf(bytesOf(literal::neighboursV4)));
  EXPECT_EQ(record.serving, (CellName{5780, 185}));
  EXPECT_EQ(record.servingRsrp, -109.375);
  EXPECT_EQ(record.servingRsrq, -9.125);
  ASSERT_EQ(record.neighbours.size(), 2U);
  EXPECT_EQ(record.neighbours[0].pci, 210);
  EXPECT_EQ(record.neighbours[0].rsrp, -118.5);
  EXPECT_EQ(record.neighbours[0].rsrq, -18.0625);
  EXPECT_EQ(record.neighbours[1].pci, 503);
  EXPECT_EQ(record.neighbours[1].rsrp, -121.0);
  EXPECT_EQ(record.neighbours[1].rsrq, -19.5);
  EXPECT_EQ(record.detectedCells, 1);
}

TEST(NeighbourMeasurementRecord, BytesBehindTheCellsAreTolerated) {
  Bytes bytes = bytesOf(literal::neighboursV4);
  append(bytes, bytesOf("de ad be ef"));
  EXPECT_EQ(std::get<NeighbourMeasurementRecord>(neighbourMeasurementOf(bytes)).neighbours.size(), 2U);
}

TEST(NeighbourMeasurementRecord, OtherVersionsAreUnknown) {
  Bytes bytes = bytesOf(literal::neighboursV4);
  for (const std::uint8_t version : Bytes{3, 5}) {
    bytes[0] = version;
    EXPECT_EQ(faultIn(neighbourMeasurementOf(bytes)), RecordFault::unknownVersion);
  }
}

TEST(NeighbourMeasurementRecord, APhysicalIdentityBeyond503IsOutOfRange) {
  Bytes serving = bytesOf(literal::neighboursV4);
  serving[13] = 0x02;
  EXPECT_EQ(faultIn(neighbourMeasurementOf(serving)), RecordFault::outOfRange);
  Bytes neighbour = bytesOf(literal::neighboursV4);
  neighbour[29] = 0x02;
  EXPECT_EQ(faultIn(neighbourMeasurementOf(neighbour)), RecordFault::outOfRange);
}

TEST(NeighbourMeasurementRecord, ARecordCutAnywhereIsTooShort) {
  expectTooShortWhenCut(bytesOf(literal::neighboursV4), neighbourMeasurementOf);
}

}  // namespace
}  // namespace vespscope::test
