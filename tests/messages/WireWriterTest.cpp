// Writing the wire format, byte by byte.
#include <limits>

#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/WireWriter.h"

namespace vespscope::test {
namespace {

template <class Write>
Bytes written(Write write) {
  WireWriter writer;
  write(writer);
  return writer.bytes();
}

TEST(WireWriter, NumbersAreVarints) {
  EXPECT_EQ(written([](WireWriter& writer) { writer.writeUint32(150, 1); }), hex("08 96 01"));
  EXPECT_EQ(written([](WireWriter& writer) { writer.writeUint32(4294967295U, 16); }), hex("80 01 ff ff ff ff 0f"));
  EXPECT_EQ(written([](WireWriter& writer) { writer.writeUint64(std::numeric_limits<std::uint64_t>::max(), 1); }),
            hex("08 ff ff ff ff ff ff ff ff ff 01"));
  EXPECT_EQ(written([](WireWriter& writer) { writer.writeInt32(7, 2); }), hex("10 07"));
}

TEST(WireWriter, ANegativeNumberThatIsNotZigZagTakesTenBytes) {
  EXPECT_EQ(written([](WireWriter& writer) { writer.writeInt32(-1, 2); }), hex("10 ff ff ff ff ff ff ff ff ff 01"));
}

TEST(WireWriter, ZigZagNumbersAlternateInSign) {
  const auto zigZag = [](std::int32_t value) {
    return written([value](WireWriter& writer) { writer.writeSint32(value, WireWriter::noField); });
  };
  EXPECT_EQ(zigZag(0), hex("00"));
  EXPECT_EQ(zigZag(-1), hex("01"));
  EXPECT_EQ(zigZag(1), hex("02"));
  EXPECT_EQ(zigZag(-2), hex("03"));
  EXPECT_EQ(zigZag(std::numeric_limits<std::int32_t>::max()), hex("fe ff ff ff 0f"));
  EXPECT_EQ(zigZag(std::numeric_limits<std::int32_t>::min()), hex("ff ff ff ff 0f"));
}

TEST(WireWriter, FlagsAreZeroOrOne) {
  EXPECT_EQ(written([](WireWriter& writer) {
              writer.writeBool(true, 1);
              writer.writeBool(false, 2);
            }),
            hex("08 01 10 00"));
}

TEST(WireWriter, BytesAndTextsCarryTheirLength) {
  EXPECT_EQ(written([](WireWriter& writer) { writer.writeBytes(hex("13 00 14"), 1); }), hex("0a 03 13 00 14"));
  EXPECT_EQ(written([](WireWriter& writer) { writer.writeBytes({}, 1); }), hex("0a 00"));
  EXPECT_EQ(written([](WireWriter& writer) { writer.writeString("ims", 3); }), hex("1a 03 69 6d 73"));
}

TEST(WireWriter, AMarkIsFilledWithTheLengthOfWhatFollows) {
  EXPECT_EQ(written([](WireWriter& writer) {
              const auto mark = writer.placeMark(5);
              writer.writeSint32(-1, WireWriter::noField);
              writer.writeSint32(1, WireWriter::noField);
              writer.recallMark(mark);
            }),
            hex("2a 02 01 02"));
}

TEST(WireWriter, AMarkMakesRoomForALengthOfSeveralBytes) {
  for (const std::size_t size : {127U, 128U, 16383U, 16384U, 3000000U}) {
    WireWriter writer;
    writer.writeUint32(1, 1);
    const auto mark = writer.placeMark(2);
    for (std::size_t index = 0; index < size; ++index) {
      writer.writeUint32(static_cast<std::uint32_t>(index & 0x7F), WireWriter::noField);
    }
    writer.recallMark(mark);
    writer.writeUint32(1, 3);

    const Bytes bytes = writer.takeBytes();
    WireReader reader(bytes);
    EXPECT_EQ(WireKey(reader.readVarint()).fieldNumber, 1);
    reader.readVarint();
    EXPECT_EQ(WireKey(reader.readVarint()).fieldNumber, 2);
    const auto content = reader.readDelimited();
    ASSERT_TRUE(content);
    ASSERT_EQ(content->size(), size);
    EXPECT_EQ(content->front(), 0);
    EXPECT_EQ(content->back(), (size - 1) & 0x7F);
    EXPECT_EQ(WireKey(reader.readVarint()).fieldNumber, 3);
  }
}

TEST(WireWriter, MarksNest) {
  EXPECT_EQ(written([](WireWriter& writer) {
              const auto outer = writer.placeMark(1);
              const auto inner = writer.placeMark(2);
              writer.writeUint32(5, 3);
              writer.recallMark(inner);
              writer.recallMark(outer);
            }),
            hex("0a 04 12 02 18 05"));
}

TEST(WireWriter, TakingTheBytesLeavesTheWriterEmpty) {
  WireWriter writer;
  writer.writeUint32(1, 1);
  EXPECT_EQ(writer.takeBytes(), hex("08 01"));
  EXPECT_TRUE(writer.bytes().empty());
}

}  // namespace
}  // namespace vespscope::test
