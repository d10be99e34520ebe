// Field numbers that are metric tags: every message class consumes and logs them as one varint, and never stores them.
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "messages/MessageClasses.h"
#include "messages/MessageTesting.h"
#include "messages/MetricTags.h"
#include "messages/WireWriter.h"
#include "messages/gsm/KCellularGsmIdleConfig.h"
#include "messages/lte/KCellularEmmContext.h"
#include "messages/lte/KCellularLteRrcState.h"
#include "messages/lte/KCellularLteSelReselCellInfo.h"
#include "platform/log/Log.h"
#include "registry/MetricRows.h"

namespace vespscope::test {
namespace {

class SystemLog {
 public:
  SystemLog() { log::discardOutputs(); }
  std::vector<std::string> lines;

 private:
  log::Observation observation_{[this](log::Channel channel, std::string_view line) {
    if (channel == log::Channel::systemLog) lines.emplace_back(line);
  }};
};

using Lines = std::vector<std::string>;

TEST(MetricTags, AFieldWithAMetricTagIsConsumedAndLogged) {
  SystemLog log;
  EXPECT_EQ(textOf(*readFrom<KCellularLteRrcState>("98 01 2a 08 05")), "[timestamp: 5]");
  EXPECT_EQ(log.lines, (Lines{"valid metricId tag", "Unknown tag: 13:42"}));
}

TEST(MetricTags, ALengthDelimitedField19IsMisreadOnPurpose) {
  // The length 4 is read as the field's value, its four bytes as keys and values of the message.
  SystemLog log;
  EXPECT_EQ(textOf(*readFrom<KCellularLteRrcState>("9a 01 04 08 05 10 03 20 07")),
            "[timestamp: 5, state: KLTE_RRC_STATE_CONNECTED, prev_state_dur_ms: 7]");
  EXPECT_EQ(log.lines, (Lines{"valid metricId tag", "Unknown tag: 13:4"}));
}

TEST(MetricTags, TheTagIsLoggedInHexadecimalAndTheValueByItsLow32Bits) {
  SystemLog log;
  // Field 54030, value 2^32 + 9.
  EXPECT_EQ(textOf(*readFrom<KCellularLteRrcState>("f0 b0 1a 89 80 80 80 10")), "[]");
  EXPECT_EQ(log.lines, (Lines{"valid metricId tag", "Unknown tag: d30e:9"}));
}

TEST(MetricTags, AValueThatCannotBeReadIsLoggedAsZero) {
  SystemLog log;
  const Bytes payload = hex("98 01 ff");
  KCellularLteRrcState message;
  WireReader reader(payload);
  EXPECT_FALSE(message.readFrom(reader));
  EXPECT_EQ(log.lines, (Lines{"valid metricId tag", "Unknown tag: 13:0"}));
}

TEST(MetricTags, WireTypeFourStopsBeforeTheRegistryIsAsked) {
  SystemLog log;
  EXPECT_EQ(textOf(*readFrom<KCellularLteRrcState>("9c 01 08 05")), "[]");
  EXPECT_TRUE(log.lines.empty());
}

TEST(MetricTags, ATagBeyond65536IsFoundModulo65536) {
  SystemLog log;
  EXPECT_EQ(textOf(*readFrom<KCellularLteRrcState>("98 81 20 07")), "[]");  // field 65555
  EXPECT_EQ(log.lines, (Lines{"valid metricId tag", "Unknown tag: 13:7"}));
}

TEST(MetricTags, NestedMessagesAskTheRegistryToo) {
  SystemLog log;
  EXPECT_EQ(textOf(*readFrom<KCellularEmmContext>("32 05 98 01 07 08 01")), "[guti: [mmegi: 1]]");
  EXPECT_EQ(log.lines, (Lines{"valid metricId tag", "Unknown tag: 13:7"}));
}

TEST(MetricTags, KnownFieldsNumbered19AreNeverStored) {
  SystemLog log;
  KCellularGsmIdleConfig idle;
  idle.setCrOffset(5);
  EXPECT_EQ(idle.encoded(), hex("98 01 05"));
  EXPECT_EQ(textOf(*readFrom<KCellularGsmIdleConfig>("98 01 05")), "[]");
  KCellularLteSelReselCellInfo reselection;
  reselection.setThreshServingLowQ(6);
  EXPECT_EQ(reselection.encoded(), hex("98 01 06"));
  EXPECT_EQ(textOf(*readFrom<KCellularLteSelReselCellInfo>("98 01 06")), "[]");
  EXPECT_EQ(log.lines, (Lines{"valid metricId tag", "Unknown tag: 13:5", "valid metricId tag", "Unknown tag: 13:6"}));
}

TEST(MetricTags, EveryClassConsumesEveryTag) {
  for (const MessageClass& messageClass : messageClasses()) {
    SystemLog log;
    WireWriter writer;
    Lines expected;
    for (const MetricRow& row : metricRows) {
      writer.writeUint32(row.tag, row.tag);
      char line[40];
      std::snprintf(line, sizeof line, "Unknown tag: %x:%u", unsigned{row.tag}, unsigned{row.tag});
      expected.insert(expected.end(), {"valid metricId tag", line});
    }
    const auto message = messageClass.make();
    WireReader reader(writer.bytes());
    EXPECT_TRUE(message->readFrom(reader)) << messageClass.name;
    EXPECT_TRUE(message->dictionaryRepresentation().empty()) << messageClass.name;
    EXPECT_EQ(log.lines, expected) << messageClass.name;
  }
}

}  // namespace
}  // namespace vespscope::test
