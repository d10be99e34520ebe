// Reading the wire format, byte by byte.
#include <limits>
#include <ostream>
#include <span>

#include <gtest/gtest.h>

#include "messages/MessageTesting.h"
#include "messages/WireReader.h"

namespace vespscope::test {
namespace {

struct Outcome {
  std::uint64_t value;
  std::size_t position;
  bool failed;
  bool operator==(const Outcome&) const = default;
};

Outcome varintIn(std::string_view digits) {
  const Bytes bytes = hex(digits);
  WireReader reader(bytes);
  const std::uint64_t value = reader.readVarint();
  return {value, reader.position(), reader.failed()};
}

TEST(WireReader, AVarintIsGroupsOfSevenBitsLowestFirst) {
  EXPECT_EQ(varintIn("00"), (Outcome{0, 1, false}));
  EXPECT_EQ(varintIn("7f"), (Outcome{127, 1, false}));
  EXPECT_EQ(varintIn("96 01"), (Outcome{150, 2, false}));
  EXPECT_EQ(varintIn("ff ff ff ff 0f"), (Outcome{4294967295U, 5, false}));
  EXPECT_EQ(varintIn("ff ff ff ff ff ff ff ff ff 01"), (Outcome{std::numeric_limits<std::uint64_t>::max(), 10, false}));
}

TEST(WireReader, AVarintOfMoreThanTenBytesYieldsZero) {
  EXPECT_EQ(varintIn("81 81 81 81 81 81 81 81 81 81 01"), (Outcome{0, 10, false}));
}

TEST(WireReader, TheTenthByteCountsWhenItEndsTheVarint) {
  EXPECT_EQ(varintIn("80 80 80 80 80 80 80 80 80 01"), (Outcome{std::uint64_t{1} << 63, 10, false}));
}

TEST(WireReader, BitsOfTheTenthByteBeyondThe64thAreDropped) {
  EXPECT_EQ(varintIn("81 80 80 80 80 80 80 80 80 7e"), (Outcome{1, 10, false}));
}

TEST(WireReader, AVarintPastTheEndYieldsZeroAndFails) {
  EXPECT_EQ(varintIn(""), (Outcome{0, 0, true}));
  EXPECT_EQ(varintIn("96"), (Outcome{0, 1, true}));
  EXPECT_EQ(varintIn("ff ff ff ff ff ff ff ff ff"), (Outcome{0, 9, true}));
}

TEST(WireReader, AfterAFailureThereIsNoMore) {
  const Bytes bytes = hex("05 01 02");
  WireReader reader(bytes);
  EXPECT_TRUE(reader.hasMore());
  EXPECT_FALSE(reader.readDelimited());
  EXPECT_TRUE(reader.failed());
  EXPECT_FALSE(reader.hasMore());
}

TEST(WireReader, ADelimitedValueIsAViewOfItsBytes) {
  const Bytes bytes = hex("03 13 00 14 00");
  WireReader reader(bytes);
  const auto value = reader.readDelimited();
  ASSERT_TRUE(value);
  EXPECT_EQ(Bytes(value->begin(), value->end()), hex("13 00 14"));
  EXPECT_EQ(value->data(), bytes.data() + 1);
  const auto empty = reader.readDelimited();
  ASSERT_TRUE(empty);
  EXPECT_TRUE(empty->empty());
}

TEST(WireReader, ALengthIsNeverNarrowedAndNeverOverflows) {
  for (const char* length :
       {"80 80 80 80 10", "ff ff ff ff ff ff ff ff ff 01", "80 80 80 80 80 80 80 80 80 01", "02"}) {
    const Bytes bytes = hex(std::string(length) + " 2a");
    WireReader delimited(bytes);
    EXPECT_FALSE(delimited.readDelimited()) << length;
    EXPECT_TRUE(delimited.failed());
    WireReader marked(bytes);
    EXPECT_FALSE(marked.placeMark()) << length;
    EXPECT_TRUE(marked.failed());
    WireReader skipped(bytes);
    EXPECT_FALSE(skipped.skip(WireKey(5 << 3 | 2))) << length;
    EXPECT_TRUE(skipped.failed());
  }
}

TEST(WireReader, AMarkBoundsReadingUntilItIsRecalled) {
  const Bytes bytes = hex("02 96 96 05");
  WireReader reader(bytes);
  const auto mark = reader.placeMark();
  ASSERT_TRUE(mark);
  EXPECT_EQ(reader.length(), 3U);
  EXPECT_EQ(reader.readVarint(), 0U) << "the third byte lies outside the mark";
  EXPECT_TRUE(reader.failed());
}

TEST(WireReader, AMarkMayReachToTheEndButNotBeyond) {
  const Bytes bytes = hex("02 01 02");
  WireReader reader(bytes);
  ASSERT_TRUE(reader.placeMark());
  EXPECT_EQ(reader.length(), 3U);
  WireReader cut(std::span<const std::uint8_t>(bytes).first(2));
  EXPECT_FALSE(cut.placeMark());
  EXPECT_TRUE(cut.failed());
}

TEST(WireReader, RecallingAMarkGoesToTheEndOfItsValue) {
  const Bytes bytes = hex("03 01 02 03 09");
  WireReader reader(bytes);
  const auto mark = reader.placeMark();
  ASSERT_TRUE(mark);
  EXPECT_EQ(reader.readVarint(), 1U);
  reader.recallMark(*mark);
  EXPECT_EQ(reader.readVarint(), 9U);
  EXPECT_FALSE(reader.hasMore());
  EXPECT_FALSE(reader.failed());
}

TEST(WireReader, AMarkInsideAMarkCannotReachBeyondIt) {
  const Bytes bytes = hex("02 03 01 02 03");
  WireReader reader(bytes);
  ASSERT_TRUE(reader.placeMark());
  EXPECT_FALSE(reader.placeMark());
  EXPECT_TRUE(reader.failed());
}

TEST(WireReader, AKeyHoldsTheFieldNumberModulo65536) {
  EXPECT_EQ(WireKey(65537 << 3 | 2).fieldNumber, 1);
  EXPECT_EQ(WireKey(65537 << 3 | 2).wireType, WireType::lengthDelimited);
  EXPECT_EQ(WireKey(std::numeric_limits<std::uint64_t>::max()).fieldNumber, 65535);
}

struct Skip {
  const char* what;
  unsigned wireType;
  const char* bytes;
  bool success;
  std::size_t position;  // after a success
  friend void PrintTo(const Skip& example, std::ostream* out) { *out << example.what; }
};

class WireReaderSkip : public testing::TestWithParam<Skip> {};

TEST_P(WireReaderSkip, GoesByTheWireType) {
  const Skip& example = GetParam();
  const Bytes bytes = hex(example.bytes);
  WireReader reader(bytes);
  EXPECT_EQ(reader.skip(WireKey(9 << 3 | example.wireType)), example.success);
  if (example.success) {
    EXPECT_EQ(reader.position(), example.position);
    EXPECT_FALSE(reader.failed());
  }
}

INSTANTIATE_TEST_SUITE_P(
    Values, WireReaderSkip,
    testing::Values(Skip{"Varint", 0, "ff 01 07", true, 2}, Skip{"TruncatedVarint", 0, "ff", false, 0},
                    Skip{"Fixed64", 1, "01 02 03 04 05 06 07 08 09", true, 8},
                    Skip{"TruncatedFixed64", 1, "01 02 03 04 05 06 07", false, 0},
                    Skip{"Delimited", 2, "02 aa bb cc", true, 3}, Skip{"TruncatedDelimited", 2, "02 aa", false, 0},
                    Skip{"Group", 3, "08 01 4c 55", true, 3}, Skip{"EmptyGroup", 3, "4c", true, 1},
                    Skip{"GroupInGroup", 3, "53 10 05 54 4c", true, 5},
                    Skip{"GroupWithDelimited", 3, "12 02 4c 4c 4c", true, 5},
                    Skip{"GroupWithoutItsEnd", 3, "08 01", false, 0},
                    Skip{"GroupWithAnotherEnd", 3, "08 01 54", false, 0},
                    Skip{"GroupsEndedInTheWrongOrder", 3, "53 4c 54", false, 0},
                    Skip{"GroupWithABadWireType", 3, "0e 4c", false, 0}, Skip{"EndOfGroup", 4, "00", false, 0},
                    Skip{"Fixed32", 5, "01 02 03 04 05", true, 4}, Skip{"TruncatedFixed32", 5, "01 02 03", false, 0},
                    Skip{"WireTypeSix", 6, "00 00", false, 0}, Skip{"WireTypeSeven", 7, "00 00", false, 0}),
    [](const auto& test) { return test.param.what; });

TEST(WireReader, AWireTypeThatDoesNotExistIsRefusedWithoutTheErrorFlag) {
  const Bytes bytes = hex("00");
  WireReader reader(bytes);
  EXPECT_FALSE(reader.skip(WireKey(9 << 3 | 6)));
  EXPECT_FALSE(reader.failed());
}

TEST(WireReader, GroupsMayNestAHundredDeepButNoDeeper) {
  for (const auto& [depth, success] : {std::pair<std::size_t, bool>{100, true}, {101, false}, {5000000, false}}) {
    Bytes bytes(depth - 1, 0x4b);            // starts of field 9; the caller has read the first one
    bytes.insert(bytes.end(), depth, 0x4c);  // their ends
    WireReader reader(bytes);
    EXPECT_EQ(reader.skip(WireKey(9 << 3 | 3)), success) << depth;
  }
}

}  // namespace
}  // namespace vespscope::test
