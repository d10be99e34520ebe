// LTE measurements of the serving cells, of literal bytes, version by version.
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Bytes.h"
#include "Faults.h"
#include "LiteralRecords.h"
#include "sources/diag/LteRecords.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;

TEST(ServingMeasurementRecord, Version19OfTheSubpacketIsRead) {
  const auto record = std::get<ServingMeasurementRecord>(servingMeasurementOf(bytesOf(literal::measurementV19)));
  EXPECT_TRUE(record.unread.empty());
  ASSERT_EQ(record.cells.size(), 1U);
  const ServingMeasurement& cell = record.cells[0];
  EXPECT_EQ(cell.cell, (CellName{5780, 185}));
  EXPECT_EQ(cell.cellIndex, 0);
  EXPECT_TRUE(cell.serving);
  EXPECT_EQ(cell.systemFrame, 1023);
  EXPECT_EQ(cell.subframe, 9);
  EXPECT_EQ(cell.antennas.at(0)->rsrp, -112.9375);
  EXPECT_EQ(cell.antennas.at(1)->rsrp, -109.5);
  EXPECT_EQ(cell.combined.rsrp, -109.5);
  EXPECT_EQ(cell.antennas.at(0)->rsrq, -8.875);
  EXPECT_EQ(cell.antennas.at(1)->rsrq, -9.25);
  EXPECT_EQ(cell.combined.rsrq, -8.875);
  EXPECT_EQ(cell.antennas.at(0)->rssi, -87.0625);
  EXPECT_EQ(cell.antennas.at(1)->rssi, -83.25);
  EXPECT_EQ(cell.combined.rssi, -83.25);
  EXPECT_DOUBLE_EQ(cell.antennas.at(0)->snr.value(), 5.2);
  EXPECT_DOUBLE_EQ(cell.antennas.at(1)->snr.value(), 4.6);
}

TEST(ServingMeasurementRecord, Version22OfTheSubpacketIsRead) {
  const auto record = std::get<ServingMeasurementRecord>(servingMeasurementOf(bytesOf(literal::measurementV22)));
  ASSERT_EQ(record.cells.size(), 1U);
  const ServingMeasurement& cell = record.cells[0];
  EXPECT_EQ(cell.cell, (CellName{1300, 503}));
  EXPECT_EQ(cell.cellIndex, 2);
  EXPECT_TRUE(cell.serving);
  EXPECT_EQ(cell.systemFrame, 517);
  EXPECT_EQ(cell.subframe, 4);
  EXPECT_EQ(cell.antennas.at(0)->rsrp, -95.0625);
  EXPECT_EQ(cell.antennas.at(1)->rsrp, -101.25);
  EXPECT_EQ(cell.combined.rsrp, -95.0625);
  EXPECT_EQ(cell.antennas.at(0)->rsrq, -10.5);
  EXPECT_EQ(cell.antennas.at(1)->rsrq, -12.0625);
  EXPECT_EQ(cell.combined.rsrq, -10.5);
  EXPECT_EQ(cell.antennas.at(0)->rssi, -64.5625);
  EXPECT_EQ(cell.antennas.at(1)->rssi, -69.1875);
  EXPECT_EQ(cell.combined.rssi, -64.5625);
  EXPECT_DOUBLE_EQ(cell.antennas.at(0)->snr.value(), -3.4);
  EXPECT_DOUBLE_EQ(cell.antennas.at(1)->snr.value(), 12.9);
}

TEST(ServingMeasurementRecord, Version18OfTheSubpacketHoldsOneCellWithoutACount) {
  const auto older = std::get<ServingMeasurementRecord>(servingMeasurementOf(bytesOf(literal::measurementV18)));
  const auto newer = std::get<ServingMeasurementRecord>(servingMeasurementOf(bytesOf(literal::measurementV19)));
  ASSERT_EQ(older.cells.size(), 1U);
  EXPECT_EQ(older.cells[0].cell, (CellName{5780, 185}));
  EXPECT_EQ(older.cells[0].systemFrame, 1023);
  EXPECT_EQ(older.cells[0].antennas, newer.cells.at(0).antennas);
  EXPECT_EQ(older.cells[0].combined, newer.cells.at(0).combined);
  EXPECT_TRUE(older.unread.empty());
}

TEST(ServingMeasurementRecord, Version36OfTheSubpacketHoldsSeveralCellsOfFourAntennas) {
  const auto record = std::get<ServingMeasurementRecord>(servingMeasurementOf(bytesOf(literal::measurementV36)));
  EXPECT_TRUE(record.unread.empty());
  ASSERT_EQ(record.cells.size(), 2U);
  const ServingMeasurement& primary = record.cells[0];
  EXPECT_EQ(primary.cell, (CellName{2500, 302}));
  EXPECT_EQ(primary.cellIndex, 0);
  EXPECT_TRUE(primary.serving);
  EXPECT_EQ(primary.systemFrame, 517);
  EXPECT_EQ(primary.subframe, 4);
  EXPECT_EQ(primary.antennas[0], (AntennaLevels{-95, -10, -68, 12.5}));
  EXPECT_EQ(primary.antennas[1], (AntennaLevels{-97.5, -11.5, -69, 11.0}));
  EXPECT_EQ(primary.antennas[2], (AntennaLevels{-101.25, -12, -72.5, 7.5}));
  EXPECT_EQ(primary.antennas[3], std::nullopt);  // outside the mask
  EXPECT_EQ(primary.combined, (AntennaLevels{-95, -10, -68, std::nullopt}));
  const ServingMeasurement& secondary = record.cells[1];
  EXPECT_EQ(secondary.cell, (CellName{2500, 17}));
  EXPECT_EQ(secondary.cellIndex, 1);
  EXPECT_EQ(secondary.antennas[2], (AntennaLevels{-92, -10, -65, 13.0}));
  EXPECT_EQ(secondary.combined, (AntennaLevels{-88, -9, -62, std::nullopt}));
}

TEST(ServingMeasurementRecord, Version48OfTheSubpacketHoldsNoSnr) {
  const auto record = std::get<ServingMeasurementRecord>(servingMeasurementOf(bytesOf(literal::measurementV48)));
  ASSERT_EQ(record.cells.size(), 1U);
  const ServingMeasurement& cell = record.cells[0];
  EXPECT_EQ(cell.cell, (CellName{66536, 411}));
  EXPECT_EQ(cell.systemFrame, 1000);
  EXPECT_EQ(cell.antennas[0], (AntennaLevels{-80, -8, -55, std::nullopt}));
  EXPECT_EQ(cell.antennas[1], (AntennaLevels{-81, -8.5, -56, std::nullopt}));
  EXPECT_EQ(cell.antennas[2], (AntennaLevels{-84, -9, -58, std::nullopt}));
  EXPECT_EQ(cell.antennas[3], (AntennaLevels{-86, -9.5, -59, std::nullopt}));
  EXPECT_EQ(cell.combined, (AntennaLevels{-80, -8, -55, std::nullopt}));
}

TEST(ServingMeasurementRecord, SubpacketsOfOtherKindsAndVersionsAreStatedAndPassedOver) {
  Bytes bytes = bytesOf("01 03 00 00 1a 13 06 00 aa bb 19 14 04 00");
  const Bytes known = bytesOf(literal::measurementV19);
  bytes.insert(bytes.end(), known.begin() + 4, known.end());
  const auto record = std::get<ServingMeasurementRecord>(servingMeasurementOf(bytes));
  EXPECT_EQ(record.cells.size(), 1U);
  EXPECT_THAT(record.unread, testing::ElementsAre(UnreadSubpacket{26, 19}, UnreadSubpacket{25, 20}));
}

TEST(ServingMeasurementRecord, CellsBehindTheFirstOfASubpacketAreStatedAsUnread) {
  Bytes bytes = bytesOf(literal::measurementV19);
  bytes[12] = 2;
  const auto record = std::get<ServingMeasurementRecord>(servingMeasurementOf(bytes));
  EXPECT_EQ(record.cells.size(), 1U);
  EXPECT_THAT(record.unread, testing::ElementsAre(UnreadSubpacket{25, 19}));
}

TEST(ServingMeasurementRecord, ASubpacketWithoutACellGivesNone) {
  const auto record =
      std::get<ServingMeasurementRecord>(servingMeasurementOf(bytesOf("01 01 00 00 19 13 0a 00 94 16 00 00 00 00")));
  EXPECT_TRUE(record.cells.empty());
  EXPECT_TRUE(record.unread.empty());
}

TEST(ServingMeasurementRecord, OtherVersionsOfTheRecordAreUnknown) {
  Bytes bytes = bytesOf(literal::measurementV19);
  for (const std::uint8_t version : Bytes{0, 2, 36}) {
    bytes[0] = version;
    EXPECT_EQ(faultIn(servingMeasurementOf(bytes)), RecordFault::unknownVersion);
  }
}

TEST(ServingMeasurementRecord, ASubpacketShorterThanItsOwnHeadIsTooShort) {
  EXPECT_EQ(faultIn(servingMeasurementOf(bytesOf("01 01 00 00 1a 13 03 00"))), RecordFault::tooShort);
}

TEST(ServingMeasurementRecord, ASubpacketWhoseSizeLeavesOutFieldsIsTooShort) {
  Bytes bytes = bytesOf(literal::measurementV19);
  for (std::uint8_t size = 0; size < 80; ++size) {
    bytes[6] = size;
    EXPECT_EQ(faultIn(servingMeasurementOf(bytes)), RecordFault::tooShort) << static_cast<int>(size);
  }
}

TEST(ServingMeasurementRecord, APhysicalIdentityBeyond503IsOutOfRange) {
  Bytes bytes = bytesOf(literal::measurementV22);
  bytes[16] = 0xF8;
  EXPECT_EQ(faultIn(servingMeasurementOf(bytes)), RecordFault::outOfRange);
}

TEST(ServingMeasurementRecord, ARecordCutAnywhereIsTooShort) {
  expectTooShortWhenCut(bytesOf(literal::measurementV19), servingMeasurementOf);
  expectTooShortWhenCut(bytesOf(literal::measurementV22), servingMeasurementOf);
  expectTooShortWhenCut(bytesOf(literal::measurementV18), servingMeasurementOf);
  expectTooShortWhenCut(bytesOf(literal::measurementV36), servingMeasurementOf);
  expectTooShortWhenCut(bytesOf(literal::measurementV48), servingMeasurementOf);
}

}  // namespace
}  // namespace vespscope::test
