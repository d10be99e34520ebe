// A result is a value or the reason why there is none.
#include <limits>

#include <gtest/gtest.h>

#include "values/Result.h"
#include "values/Value.h"

namespace vespscope::test {
namespace {

TEST(Result, HoldsAValueOrAReason) {
  const Result<int> good(4);
  ASSERT_TRUE(good.ok());
  EXPECT_EQ(*good, 4);
  const Result<int> bad = Failure{"no such file"};
  ASSERT_FALSE(bad.ok());
  EXPECT_EQ(bad.reason(), "no such file");
}

}  // namespace
}  // namespace vespscope::test
