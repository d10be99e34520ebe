// The UMTS serving cell record, of literal bytes.
#include <gtest/gtest.h>

#include "Bytes.h"
#include "LiteralRecords.h"
#include "sources/diag/WcdmaRecords.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;

TEST(WcdmaCellRecord, IsRead) {
  EXPECT_EQ(std::get<WcdmaCellRecord>(wcdmaCellOf(bytesOf(literal::wcdmaCell))),
            (WcdmaCellRecord{.uplinkUarfcn = 9490,
                             .downlinkUarfcn = 9890,
                             .cellIdentity = 0x01020304,
                             .primaryScramblingCode = 293,
                             .plmn = radio::Plmn::fromText("310260"),
                             .locationAreaCode = 7145,
                             .routingAreaCode = 18}));
}

TEST(WcdmaCellRecord, ANetworkCodeMayHaveTwoDigitsOrNone) {
  Bytes bytes = bytesOf(literal::wcdmaCell);
  bytes[23] = 0x0F;
  EXPECT_EQ(std::get<WcdmaCellRecord>(wcdmaCellOf(bytes)).plmn, radio::Plmn::fromText("31026"));
  bytes[18] = 0xFF;
  EXPECT_FALSE(std::get<WcdmaCellRecord>(wcdmaCellOf(bytes)).plmn);
}

TEST(WcdmaCellRecord, ImpossibleNumbersAndCutRecordsAreFaults) {
  Bytes bytes = bytesOf(literal::wcdmaCell);
  for (std::size_t length = 0; length < bytes.size(); ++length) {
    EXPECT_EQ(std::get<RecordFault>(wcdmaCellOf(std::span(bytes).first(length))), RecordFault::tooShort);
  }
  bytes[17] = 0x20;
  EXPECT_EQ(std::get<RecordFault>(wcdmaCellOf(bytes)), RecordFault::outOfRange);
}

}  // namespace
}  // namespace vespscope::test
