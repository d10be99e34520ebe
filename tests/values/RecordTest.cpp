#include <limits>

#include <gtest/gtest.h>

#include "values/Result.h"
#include "values/Value.h"

namespace vespscope {
namespace {

TEST(Record, KeepsInsertionOrder) {
  Record record;
  record.set("timestamp", 7);
  record.set("state", "IDLE");
  record.set("cause", 3U);
  ASSERT_EQ(record.size(), 3U);
  EXPECT_EQ(record.at(0).key.view(), "timestamp");
  EXPECT_EQ(record.at(1).key.view(), "state");
  EXPECT_EQ(record.at(2).key.view(), "cause");
}

TEST(Record, SettingAPresentKeyReplacesItsValueInPlace) {
  Record record{{"first", 1}, {"second", 2}};
  record.set("first", 9);
  ASSERT_EQ(record.size(), 2U);
  EXPECT_EQ(record.at(0).key.view(), "first");
  EXPECT_EQ(record.at(0).value, Value(9));
}

TEST(Record, RemovingTellsWhetherTheKeyWasThere) {
  Record record{{"first", 1}, {"second", 2}};
  EXPECT_TRUE(record.remove("first"));
  EXPECT_FALSE(record.remove("first"));
  ASSERT_EQ(record.size(), 1U);
  EXPECT_EQ(record.find("first"), nullptr);
  EXPECT_NE(record.find("second"), nullptr);
}

TEST(Record, IsEqualToOneWithTheSamePairsInAnotherOrder) {
  const Record one{{"first", 1}, {"second", 2}};
  const Record other{{"second", 2}, {"first", 1}};
  EXPECT_EQ(one, other);
  EXPECT_FALSE((one == Record{{"first", 1}}));
  EXPECT_FALSE((one == Record{{"first", 1}, {"third", 2}}));
  EXPECT_FALSE((one == Record{{"first", 1}, {"second", 3}}));
}

TEST(Record, ACopyDoesNotFollowLaterChanges) {
  Record record{{"list", List{Record{{"rsrp", -90}}}}};
  const Record snapshot = record;
  record.find("list")->asList()->front().asRecord()->set("rsrp", -100);
  EXPECT_EQ(*snapshot.find("list")->asList()->front().asRecord()->find("rsrp"), Value(-90));
}

TEST(Record, APositionBeyondTheEndThrows) {
  const Record record{{"only", 1}};
  EXPECT_THROW(static_cast<void>(record.at(1)), std::out_of_range);
}

TEST(Key, OfALiteralPointsAtTheLiteral) {
  static constexpr char name[] = "tracking_area_code";
  const Key key = Key::ofStatic(name);
  EXPECT_EQ(key.view().data(), name);
  EXPECT_EQ(key.view(), "tracking_area_code");
}

TEST(Key, OfOtherTextKeepsItsOwnCopy) {
  std::string text = "a key made at run time, longer than any small buffer";
  const Key key(text);
  const Key copy = key;
  Key moved = Key(text);
  const Key target = std::move(moved);
  text.assign(text.size(), 'x');
  EXPECT_EQ(key.view(), "a key made at run time, longer than any small buffer");
  EXPECT_EQ(copy, key);
  EXPECT_EQ(target, key);
}

TEST(Key, OfEmptyTextIsEmpty) { EXPECT_EQ(Key(std::string()).view(), ""); }

TEST(Key, IsAssignableFromBothKinds) {
  Key key("literal");
  key = Key(std::string("text"));
  EXPECT_EQ(key.view(), "text");
  const Key literal("other");
  key = literal;
  EXPECT_EQ(key.view(), "other");
}

TEST(Value, NumbersAreEqualByValueWhateverTheirWidth) {
  EXPECT_EQ(Value(53522U), Value(std::int64_t{53522}));
  EXPECT_EQ(Value(std::uint64_t{5}), Value(5));
  EXPECT_EQ(Value(20.0F), Value(20));
  EXPECT_FALSE(Value(-1) == Value(std::numeric_limits<std::uint32_t>::max()));
  EXPECT_FALSE(Value(-1) == Value(std::numeric_limits<std::uint64_t>::max()));
}

TEST(Value, ABooleanIsNoNumber) {
  EXPECT_FALSE(Value(true) == Value(1));
  EXPECT_FALSE(Value(true).isNumber());
  EXPECT_EQ(Value(true).asInteger(), std::nullopt);
  EXPECT_EQ(Value(true).asBool(), true);
}

TEST(Value, OfDifferentKindsAreUnequal) {
  EXPECT_FALSE(Value("2") == Value(2));
  EXPECT_FALSE(Value() == Value(0));
  EXPECT_EQ(Value(), Value());
  EXPECT_FALSE(Value(Bytes{0x31}) == Value("1"));
}

TEST(Value, AsIntegerTakesEveryIntegerKindInRange) {
  EXPECT_EQ(Value(-7).asInteger(), -7);
  EXPECT_EQ(Value(4000000000U).asInteger(), 4000000000);
  EXPECT_EQ(Value(std::numeric_limits<std::uint64_t>::max()).asInteger(), std::nullopt);
  EXPECT_EQ(Value(2.0).asInteger(), std::nullopt);
  EXPECT_EQ(Value("2").asInteger(), std::nullopt);
}

TEST(Value, AsInt32RefusesWhatDoesNotFit) {
  EXPECT_EQ(Value(std::numeric_limits<std::int32_t>::min()).asInt32(), std::numeric_limits<std::int32_t>::min());
  EXPECT_EQ(Value(2147483648U).asInt32(), std::nullopt);
}

TEST(Value, AsFloatTakesOnlyWhatAFloatHoldsExactly) {
  EXPECT_EQ(Value(97U).asFloat(), 97.0F);
  EXPECT_EQ(Value(16777216).asFloat(), 16777216.0F);
  EXPECT_EQ(Value(16777217).asFloat(), std::nullopt);
  EXPECT_EQ(Value(std::numeric_limits<std::int32_t>::max()).asFloat(), std::nullopt);
  EXPECT_EQ(Value(std::numeric_limits<std::uint64_t>::max()).asFloat(), std::nullopt);
  EXPECT_EQ(Value(std::numeric_limits<std::int64_t>::min()).asFloat(), -9223372036854775808.0F);
  EXPECT_EQ(Value(0.5).asFloat(), 0.5F);
  EXPECT_EQ(Value(0.1).asFloat(), std::nullopt);
  EXPECT_EQ(Value(1e300).asFloat(), std::nullopt);
  EXPECT_EQ(Value("97").asFloat(), std::nullopt);
}

TEST(Value, AsDoubleTakesEveryNumber) {
  EXPECT_EQ(Value(std::uint64_t{1700000000123}).asDouble(), 1700000000123.0);
  EXPECT_EQ(Value(-0.5F).asDouble(), -0.5);
  EXPECT_EQ(Value("1").asDouble(), std::nullopt);
}

TEST(IsRecordList, TakesAListOfRecordsOnly) {
  EXPECT_TRUE(isRecordList(Value(List{})));
  EXPECT_TRUE(isRecordList(Value(List{Record{{"psc", 293}}})));
  EXPECT_FALSE(isRecordList(Value(List{Record{}, 1})));
  EXPECT_FALSE(isRecordList(Value(Record{})));
  EXPECT_FALSE(isRecordList(Value("text")));
}

TEST(RecordAssign, BecomesACopyWhateverItWasBefore) {
  const Record source{{"psc", 293}, {"plmn", "310-260"}, {std::string("own"), List{1, 2}}};
  Record record;
  record.assign(source, 2);
  EXPECT_EQ(record, source);
  record.set("timestamp", "now");
  EXPECT_EQ(source.size(), 3U);
  record.assign(Record{{"rscp", -90}}, 0);
  EXPECT_EQ(record, (Record{{"rscp", -90}}));
  record.assign(source, 0);
  EXPECT_EQ(record, source);
  record.assign(Record{}, 0);
  EXPECT_TRUE(record.empty());
}

TEST(Result, HoldsAValueOrAReason) {
  const Result<int> good(4);
  ASSERT_TRUE(good.ok());
  EXPECT_EQ(*good, 4);
  const Result<int> bad = Failure{"no such file"};
  ASSERT_FALSE(bad.ok());
  EXPECT_EQ(bad.reason(), "no such file");
}

}  // namespace
}  // namespace vespscope
