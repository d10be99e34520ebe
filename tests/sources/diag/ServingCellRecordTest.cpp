// Serving cell records of LTE, of literal bytes, version by version.
#include <gtest/gtest.h>

#include "Bytes.h"
#include "Faults.h"
#include "LiteralRecords.h"
#include "sources/diag/LteRecords.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;

TEST(ServingCellRecord, Version3HasWideCarrierNumbers) {
  const auto record = std::get<ServingCellRecord>(servingCellOf(bytesOf(literal::servingCellV3)));
  EXPECT_EQ(record, (ServingCellRecord{.cell = {5780, 185},
                                       .uplinkEarfcn = 23780,
                                       .downlinkBlocks = 50,
                                       .uplinkBlocks = 25,
                                       .cellIdentity = 0x04030201,
                                       .trackingAreaCode = 0x1234,
                                       .band = 17,
                                       .plmn = radio::Plmn::fromText("310410")}));
}

TEST(ServingCellRecord, Version2HasNarrowCarrierNumbers) {
  const auto record = std::get<ServingCellRecord>(servingCellOf(bytesOf(literal::servingCellV2)));
  EXPECT_EQ(record, (ServingCellRecord{.cell = {1300, 503},
                                       .uplinkEarfcn = 19300,
                                       .downlinkBlocks = 100,
                                       .uplinkBlocks = 75,
                                       .cellIdentity = 0x0FFFFFFF,
                                       .trackingAreaCode = 0xFFFE,
                                       .band = 3,
                                       .plmn = radio::Plmn::fromText("26201")}));
}

TEST(ServingCellRecord, OtherVersionsAreUnknown) {
  Bytes bytes = bytesOf(literal::servingCellV3);
  for (const std::uint8_t version : Bytes{0, 1, 4, 255}) {
    bytes[0] = version;
    EXPECT_EQ(faultIn(servingCellOf(bytes)), RecordFault::unknownVersion);
  }
}

TEST(ServingCellRecord, APhysicalIdentityBeyond503IsOutOfRange) {
  Bytes bytes = bytesOf(literal::servingCellV3);
  bytes[1] = 0xF8;
  bytes[2] = 0x01;
  EXPECT_EQ(faultIn(servingCellOf(bytes)), RecordFault::outOfRange);
}

TEST(ServingCellRecord, ARecordCutAnywhereIsTooShort) {
  expectTooShortWhenCut(bytesOf(literal::servingCellV3), servingCellOf);
  expectTooShortWhenCut(bytesOf(literal::servingCellV2), servingCellOf);
}

}  // namespace
}  // namespace vespscope::test
