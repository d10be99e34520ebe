// LTE neighbour records from literal bytes.
#include <gtest/gtest.h>

#include "Bytes.h"
#include "LiteralRecords.h"
#include "sources/diag/LteRecords.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;

TEST(NeighbourRecords, ConnectedModeGivesTheCellsOfACarrier) {
  const auto record = std::get<NeighbourCarriersRecord>(connectedNeighboursOf(bytesOf(literal::connectedNeighbours)));
  EXPECT_TRUE(record.unread.empty());
  ASSERT_EQ(record.carriers.size(), 1U);
  EXPECT_EQ(record.carriers[0].earfcn, 5780U);
  ASSERT_EQ(record.carriers[0].neighbours.size(), 2U);
  EXPECT_EQ(record.carriers[0].neighbours[0].pci, 210);
  EXPECT_EQ(record.carriers[0].neighbours[0].rsrp, -118.5);
  EXPECT_EQ(record.carriers[0].neighbours[0].rsrq, -18.0625);
  EXPECT_EQ(record.carriers[0].neighbours[1].pci, 503);
  EXPECT_EQ(record.carriers[0].neighbours[1].rsrp, -121);
  EXPECT_EQ(record.carriers[0].neighbours[1].rsrq, -19.5);
}

TEST(NeighbourRecords, IdleModeHasASubpacketOfItsOwn) {
  const Bytes idle = bytesOf(literal::idleNeighbours);
  const auto record = std::get<NeighbourCarriersRecord>(idleNeighboursOf(idle));
  ASSERT_EQ(record.carriers.size(), 1U);
  EXPECT_EQ(record.carriers[0].earfcn, 1300U);
  ASSERT_EQ(record.carriers[0].neighbours.size(), 1U);
  EXPECT_EQ(record.carriers[0].neighbours[0].pci, 1);
  EXPECT_EQ(record.carriers[0].neighbours[0].rsrp, -100);
  EXPECT_EQ(record.carriers[0].neighbours[0].rsrq, -10);

  const auto other = std::get<NeighbourCarriersRecord>(connectedNeighboursOf(idle));
  EXPECT_TRUE(other.carriers.empty());
  EXPECT_EQ(other.unread, (std::vector<UnreadSubpacket>{{27, 4}}));
}

TEST(NeighbourRecords, AnotherVersionOfTheSubpacketIsLeftOut) {
  Bytes bytes = bytesOf(literal::connectedNeighbours);
  bytes[5] = 24;
  const auto record = std::get<NeighbourCarriersRecord>(connectedNeighboursOf(bytes));
  EXPECT_TRUE(record.carriers.empty());
  EXPECT_EQ(record.unread, (std::vector<UnreadSubpacket>{{31, 24}}));
}

TEST(NeighbourRecords, AnotherVersionOfTheRecordIsUnknown) {
  Bytes bytes = bytesOf(literal::connectedNeighbours);
  bytes[0] = 2;
  EXPECT_EQ(std::get<RecordFault>(connectedNeighboursOf(bytes)), RecordFault::unknownVersion);
}

TEST(NeighbourRecords, APhysicalIdentityBeyond503IsOutOfRange) {
  Bytes bytes = bytesOf(literal::connectedNeighbours);
  bytes[68] = 0xF8;
  EXPECT_EQ(std::get<RecordFault>(connectedNeighboursOf(bytes)), RecordFault::outOfRange);
}

TEST(NeighbourRecords, ARecordCutAnywhereIsTooShort) {
  const Bytes whole = bytesOf(literal::connectedNeighbours);
  for (std::size_t length = 0; length < whole.size(); ++length) {
    const Bytes cut(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length));
    EXPECT_EQ(std::get<RecordFault>(connectedNeighboursOf(cut)), RecordFault::tooShort) << length;
  }
}

TEST(NeighbourRecords, MoreCellsThanTheSubpacketHoldsAreTooShort) {
  Bytes bytes = bytesOf(literal::connectedNeighbours);
  bytes[12] = 3;
  EXPECT_EQ(std::get<RecordFault>(connectedNeighboursOf(bytes)), RecordFault::tooShort);
}

}  // namespace
}  // namespace vespscope::test
