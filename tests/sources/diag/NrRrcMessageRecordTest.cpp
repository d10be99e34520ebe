// NR's log records from literal bytes.
#include <gtest/gtest.h>

#include "Bytes.h"
#include "sources/diag/NrRecords.h"

namespace vespscope::test {
namespace {

using sources::diag::NrRrcContent;
using sources::diag::nrRrcMessageOf;
using sources::diag::NrRrcMessageRecord;
using sources::diag::RecordFault;

// Version 8, release 15.3, bearer 1, cell 138 on 504990, a message of uplink DCCH of three bytes.
const Bytes uplink = bytesOf("08 00 00 00 0f 03 01 8a 00 9e b4 07 00 11 22 33 44 08 00 00 00 00 03 00 aa bb cc");

TEST(NrRrcMessageRecord, NamesTheCellAndHoldsTheMessage) {
  const auto decoded = nrRrcMessageOf(uplink);
  const auto& record = std::get<NrRrcMessageRecord>(decoded);
  EXPECT_EQ(record.pci, 138);
  EXPECT_EQ(record.nrArfcn, 504'990U);
  EXPECT_EQ(record.radioBearer, 1);
  EXPECT_EQ(record.content, NrRrcContent::uplinkDcch);
  EXPECT_EQ(Bytes(record.message.begin(), record.message.end()), bytesOf("aa bb cc"));
}

TEST(NrRrcMessageRecord, KnowsWhatIsCarriedByLte) {
  Bytes bytes = uplink;
  for (const std::uint8_t type : Bytes{1, 8, 9, 10, 25, 26}) {
    bytes[17] = type;
    EXPECT_EQ(static_cast<std::uint8_t>(std::get<NrRrcMessageRecord>(nrRrcMessageOf(bytes)).content), type);
  }
  bytes[17] = 11;
  EXPECT_EQ(std::get<NrRrcMessageRecord>(nrRrcMessageOf(bytes)).content, NrRrcContent::other);
}

TEST(NrRrcMessageRecord, RefusesOtherVersionsCutsAndBytesLeft) {
  Bytes other = uplink;
  other[0] = 9;
  EXPECT_EQ(std::get<RecordFault>(nrRrcMessageOf(other)), RecordFault::unknownVersion);
  for (std::size_t length = 0; length < uplink.size(); ++length) {
    const Bytes cut(uplink.begin(), uplink.begin() + static_cast<std::ptrdiff_t>(length));
    EXPECT_EQ(std::get<RecordFault>(nrRrcMessageOf(cut)), RecordFault::tooShort) << length;
  }
  Bytes longer = uplink;
  longer.push_back(0);
  EXPECT_EQ(std::get<RecordFault>(nrRrcMessageOf(longer)), RecordFault::bytesLeft);
  Bytes beyond = uplink;
  beyond[8] = 0x04;
  EXPECT_EQ(std::get<RecordFault>(nrRrcMessageOf(beyond)), RecordFault::outOfRange);
}

}  // namespace
}  // namespace vespscope::test
