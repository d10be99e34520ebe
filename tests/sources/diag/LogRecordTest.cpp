// The header of a record: code, time and payload.
#include <gtest/gtest.h>

#include "Bytes.h"
#include "sources/diag/LogRecord.h"

namespace vespscope::test {
namespace {

using namespace sources::diag;

const LogRecord& recordIn(const std::variant<LogRecord, FrameFault>& parsed) { return std::get<LogRecord>(parsed); }

FrameFault faultIn(std::string_view dump) {
  const Bytes frame = bytesOf(dump);
  const auto parsed = logRecordOf(frame);
  return std::get<FrameFault>(parsed);
}

TEST(LogRecord, CodeTimeAndPayloadAreTaken) {
  const Bytes frame = bytesOf("10 00 0e 00 0e 00 c2 b0 00 00 21 24 29 ca d3 00 7e 7d");
  const auto parsed = logRecordOf(frame);
  const LogRecord& record = recordIn(parsed);
  EXPECT_EQ(record.code, 0xB0C2);
  EXPECT_EQ(record.radio, 0U);
  EXPECT_EQ(Bytes(record.payload.begin(), record.payload.end()), bytesOf("7e 7d"));
  // 2016-01-17 03:40:41.64125 UTC: 909629793313 steps of 1.25 ms since 1980-01-06.
  EXPECT_EQ(record.time.count(), 1'453'002'041'641'250'000);
}

TEST(LogRecord, TheLowestSixteenBitsOfTheTimeAreNotPartOfIt) {
  const Bytes frame = bytesOf("10 00 0c 00 0c 00 c2 b0 ff ff 01 00 00 00 00 00");
  const auto parsed = logRecordOf(frame);
  EXPECT_EQ(recordIn(parsed).time.count(), 315'964'800'001'250'000);
}

TEST(LogRecord, ARecordFromBeforeNetworkTimeIsNear1980) {
  const Bytes frame = bytesOf("10 00 0c 00 0c 00 c2 b0 00 00 00 00 00 00 00 00");
  const auto parsed = logRecordOf(frame);
  EXPECT_EQ(recordIn(parsed).time, std::chrono::seconds(315'964'800));
}

TEST(LogRecord, AWrapperGivesTheRadio) {
  const Bytes frame = bytesOf("98 01 00 00 02 00 00 00 10 00 0e 00 0e 00 c2 b0 00 00 21 24 29 ca d3 00 7e 7d");
  const auto parsed = logRecordOf(frame);
  EXPECT_EQ(recordIn(parsed).radio, 2U);
  EXPECT_EQ(recordIn(parsed).code, 0xB0C2);
  EXPECT_EQ(recordIn(parsed).payload.size(), 2U);
}

TEST(LogRecord, ALongerWrapperHeadIsMalformed) {
  EXPECT_EQ(faultIn("98 01 01 00 02 00 00 00 10 00 0c 00 0c 00 c2 b0 00 00 00 00 00 00 00 00"), FrameFault::malformed);
}

TEST(LogRecord, AWrapperInAWrapperIsOfAnotherKind) {
  EXPECT_EQ(faultIn("98 01 00 00 01 00 00 00 98 01 00 00 01 00 00 00 10 00 0c 00 0c 00 c2 b0 00 00 00 00 00 00 00 00"),
            FrameFault::otherKind);
}

TEST(LogRecord, AnotherFirstByteIsOfAnotherKind) {
  EXPECT_EQ(faultIn("79 00 0c 00 0c 00 c2 b0 00 00 00 00 00 00 00 00"), FrameFault::otherKind);
  EXPECT_EQ(faultIn(""), FrameFault::otherKind);
}

TEST(LogRecord, LengthsThatDifferAreMalformed) {
  EXPECT_EQ(faultIn("10 00 0c 00 0d 00 c2 b0 00 00 00 00 00 00 00 00 00"), FrameFault::malformed);
}

TEST(LogRecord, ALengthBelowTheHeadIsMalformed) {
  EXPECT_EQ(faultIn("10 00 0b 00 0b 00 c2 b0 00 00 00 00 00 00 00 00"), FrameFault::malformed);
}

TEST(LogRecord, ALengthPastTheFrameIsMalformed) {
  EXPECT_EQ(faultIn("10 00 0d 00 0d 00 c2 b0 00 00 00 00 00 00 00 00"), FrameFault::malformed);
}

TEST(LogRecord, BytesBehindTheLengthAreNoPayload) {
  const Bytes frame = bytesOf("10 00 0d 00 0d 00 c2 b0 00 00 00 00 00 00 00 00 aa bb cc");
  const auto parsed = logRecordOf(frame);
  EXPECT_EQ(Bytes(recordIn(parsed).payload.begin(), recordIn(parsed).payload.end()), bytesOf("aa"));
}

TEST(LogRecord, ATimeBeyondTheNanosecondsClockIsRefused) {
  EXPECT_EQ(faultIn("10 00 0c 00 0c 00 c2 b0 00 00 ff ff ff ff ff ff"), FrameFault::timeTooLate);
}

TEST(LogRecord, AFrameCutAnywhereIsNoRecord) {
  const Bytes whole = bytesOf("98 01 00 00 02 00 00 00 10 00 0e 00 0e 00 c2 b0 00 00 21 24 29 ca d3 00 7e 7d");
  for (std::size_t length = 0; length < whole.size(); ++length) {
    const Bytes cut(whole.begin(), whole.begin() + static_cast<std::ptrdiff_t>(length));
    const auto parsed = logRecordOf(cut);
    EXPECT_TRUE(std::holds_alternative<FrameFault>(parsed)) << length;
  }
}

}  // namespace
}  // namespace vespscope::test
