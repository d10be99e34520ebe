// Records keep the order of their entries and their own copies.
#include <limits>

#include <gtest/gtest.h>

#include "values/Result.h"
#include "values/Value.h"

namespace vespscope::test {
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

TEST(Record, RemovingReturnsWhetherTheKeyExisted) {
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

}  // namespace
}  // namespace vespscope::test
