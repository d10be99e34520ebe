// Keys of records: literals are referenced, other texts are copied.
#include <limits>

#include <gtest/gtest.h>

#include "values/Result.h"
#include "values/Value.h"

namespace vespscope::test {
namespace {

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

}  // namespace
}  // namespace vespscope::test
