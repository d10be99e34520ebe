// Whether two payloads are equal apart from their timestamps.
#include <string>
#include <vector>

#include <gtest/gtest.h>

#include "manager/Payload.h"

namespace vespscope::test {
namespace {

using manager::sameButForTimestamp;

TEST(Payload, LeavesTheTimestampAside) {
  EXPECT_TRUE(sameButForTimestamp({}, {}));
  EXPECT_TRUE(sameButForTimestamp({0x08, 0x01}, {}));
  EXPECT_TRUE(sameButForTimestamp({0x08, 0x01, 0x10, 0x05}, {0x08, 0xFF, 0x7F, 0x10, 0x05}));
  EXPECT_TRUE(sameButForTimestamp({0x10, 0x05, 0x08, 0x01}, {0x08, 0x02, 0x10, 0x05}));
  EXPECT_FALSE(sameButForTimestamp({0x10, 0x05}, {0x10, 0x06}));
  EXPECT_FALSE(sameButForTimestamp({0x10, 0x05}, {0x10, 0x05, 0x18, 0x00}));
}

TEST(Payload, SkipsFieldsOfEveryWireType) {
  const Bytes one = {0x11, 1, 2, 3, 4, 5, 6, 7, 8, 0x1A, 0x02, 0x08, 0x01, 0x25, 1, 2, 3, 4, 0x08, 0x01};
  Bytes other = one;
  other.back() = 0x02;
  EXPECT_TRUE(sameButForTimestamp(one, other));
  other[12] = 0x02;  // in the nested message, whose field 1 is not a timestamp
  EXPECT_FALSE(sameButForTimestamp(one, other));
}

TEST(Payload, OfBytesInNoWireFormatComparesThemWhole) {
  EXPECT_TRUE(sameButForTimestamp({0xFF}, {0xFF}));
  EXPECT_FALSE(sameButForTimestamp({0x08}, {0x08, 0x01}));
  EXPECT_FALSE(sameButForTimestamp({0x0B, 0x01}, {0x0B, 0x02}));              // a group
  EXPECT_FALSE(sameButForTimestamp({0x0A, 0x7F, 0x01}, {0x0A, 0x7F, 0x02}));  // a length beyond the end
  EXPECT_FALSE(sameButForTimestamp(Bytes(11, 0x80), Bytes(12, 0x80)));        // a varint without an end
}

}  // namespace
}  // namespace vespscope::test
