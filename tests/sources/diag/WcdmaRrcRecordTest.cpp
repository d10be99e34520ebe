// The head of a UMTS RRC message record.
#include <gtest/gtest.h>

#include "Bytes.h"
#include "sources/diag/WcdmaRecords.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;
using Channel = WcdmaChannel;

TEST(WcdmaRrcRecord, HasOneOfFourChannels) {
  const Bytes bytes = bytesOf("03 02 02 00 44 20 ff");
  const auto record = std::get<WcdmaRrcRecord>(wcdmaRrcOf(bytes));
  EXPECT_EQ(record.channel, Channel::downlinkDcch);
  EXPECT_EQ(record.radioBearer, 2);
  EXPECT_EQ(Bytes(record.message.begin(), record.message.end()), bytesOf("44 20"));
  EXPECT_EQ(std::get<RecordFault>(wcdmaRrcOf(bytesOf("84 28 00 00"))), RecordFault::unknownVersion);
  EXPECT_EQ(std::get<RecordFault>(wcdmaRrcOf(bytesOf("03 02 03 00 44 20"))), RecordFault::tooShort);
  EXPECT_EQ(std::get<RecordFault>(wcdmaRrcOf(bytesOf("03 02"))), RecordFault::tooShort);
  EXPECT_EQ(std::get<RecordFault>(wcdmaRrcOf({})), RecordFault::tooShort);
}

}  // namespace
}  // namespace vespscope::test
