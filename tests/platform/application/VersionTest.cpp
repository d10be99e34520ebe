// The platform's version, and what a program finds at least.
#include <gtest/gtest.h>

#include "platform/application/System.h"

namespace vespscope::test {
namespace {

using namespace application;

TEST(Version, IsThirteenUnlessSetOtherwise) {
  EXPECT_TRUE(isPlatformAtLeast({13, 0, 0}));
  EXPECT_TRUE(isPlatformAtLeast({12, 9, 9}));
  EXPECT_FALSE(isPlatformAtLeast({13, 0, 1}));
  setPlatformVersion({12, 4, 1});
  EXPECT_FALSE(isPlatformAtLeast({13, 0, 0}));
  EXPECT_TRUE(isPlatformAtLeast({12, 4, 1}));
}

}  // namespace
}  // namespace vespscope::test
