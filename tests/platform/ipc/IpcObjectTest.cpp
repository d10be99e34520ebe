// Objects that processes exchange, and their conversion into plain values.
#include <gtest/gtest.h>

#include "platform/ipc/IpcObject.h"

namespace vespscope::test {
namespace {

using namespace ipc;

TEST(IpcObjectDictionary, KeepsTheOrderInWhichEntriesWereSet) {
  Dictionary dictionary;
  dictionary.set("kKeyAppID", Object(std::int64_t{2}));
  dictionary.set("kKeyPayload", Object(Bytes{1}));
  dictionary.set("kKeyAppID", Object(std::int64_t{3}));
  ASSERT_EQ(dictionary.size(), 2U);
  EXPECT_EQ(dictionary.entries().at(0).first, "kKeyAppID");
  EXPECT_EQ(*dictionary.find("kKeyAppID")->asInt64(), 3);
  EXPECT_EQ(dictionary.find("other"), nullptr);
}

TEST(IpcObjectKinds, ReportsItsType) {
  EXPECT_EQ(Object().type(), Type::null);
  EXPECT_EQ(Object(true).type(), Type::boolean);
  EXPECT_EQ(Object(std::int64_t{-1}).type(), Type::int64);
  EXPECT_EQ(Object(std::uint64_t{1}).type(), Type::uint64);
  EXPECT_EQ(Object(0.5).type(), Type::real);
  EXPECT_EQ(Object(std::string("s")).type(), Type::string);
  EXPECT_EQ(Object(Bytes{}).type(), Type::data);
  EXPECT_EQ(Object(Array{}).type(), Type::array);
  EXPECT_EQ(Object(Dictionary{}).type(), Type::dictionary);
}

TEST(IpcObjectKinds, BecomesThePlainValueOfTheSameKind) {
  EXPECT_TRUE(toValue(Object()).isNull());
  EXPECT_EQ(toValue(Object(true)).asBool(), true);
  EXPECT_EQ(toValue(Object(std::int64_t{3952132})).asInteger(), 3952132);
  EXPECT_EQ(toValue(Object(std::uint64_t{7})).asInteger(), 7);
  EXPECT_EQ(toValue(Object(0.5)).asDouble(), 0.5);
  EXPECT_EQ(*toValue(Object(std::string("text"))).asText(), "text");
  EXPECT_EQ(*toValue(Object(Bytes{1, 2})).asBytes(), (Bytes{1, 2}));
}

TEST(IpcObjectKinds, SharesItsDataWithTheValueMadeOfIt) {
  const Object object(Bytes{1, 2});
  EXPECT_EQ(toValue(object).asBytes(), object.asData());
}

TEST(IpcObjectDictionary, BecomesARecordWithNothingAddedOrRemoved) {
  Dictionary inner;
  inner.set("k", Object(std::string("v")));
  Dictionary event;
  event.set("kKeyMetricID", Object(std::int64_t{3952132}));
  event.set("kKeyPayload", Object(Bytes{8, 1}));
  event.set("nested", Object(inner));
  event.set("list", Object(Array{Object(std::int64_t{1}), Object(inner)}));
  event.set("nothing", Object());
  const Record expected{{"kKeyMetricID", 3952132},
                        {"kKeyPayload", Bytes{8, 1}},
                        {"nested", Record{{"k", "v"}}},
                        {"list", List{1, Record{{"k", "v"}}}},
                        {"nothing", Value()}};
  EXPECT_EQ(toRecord(event), expected);
}

TEST(IpcObjectDictionary, KeepsNamesApartHoweverManyThereAre) {
  for (int round = 0; round < 2; ++round) {
    for (int number = 0; number < 100; ++number) {
      const std::string name = std::string(static_cast<std::size_t>(number), 'n') + std::to_string(number);
      Dictionary event;
      event.set(name, Object(std::int64_t{number}));
      EXPECT_EQ(toRecord(event), (Record{{name, number}}));
    }
  }
}

}  // namespace
}  // namespace vespscope::test
