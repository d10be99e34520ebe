// Values: equality by number, conversions that fail, lists of records.
#include <limits>

#include <gtest/gtest.h>

#include "values/Result.h"
#include "values/Value.h"

namespace vespscope::test {
namespace {

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

TEST(ValueIsRecordList, TakesAListOfRecordsOnly) {
  EXPECT_TRUE(isRecordList(Value(List{})));
  EXPECT_TRUE(isRecordList(Value(List{Record{{"psc", 293}}})));
  EXPECT_FALSE(isRecordList(Value(List{Record{}, 1})));
  EXPECT_FALSE(isRecordList(Value(Record{})));
  EXPECT_FALSE(isRecordList(Value("text")));
}

}  // namespace
}  // namespace vespscope::test
