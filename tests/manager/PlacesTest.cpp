// Places of the manager: who gets one, at each limit and next to it.
#include <gtest/gtest.h>

#include "manager/Places.h"

namespace vespscope::test {
namespace {

using manager::Places;

constexpr std::uint32_t administrator = 0;
constexpr std::uint32_t owner = 1000;

// Takes `count` places; returns true when all were free.
bool take(Places& places, std::uint32_t user, std::size_t count) {
  for (; count > 0; --count) {
    if (places.take(user)) return false;
  }
  return true;
}

TEST(Places, AreEightForAUser) {
  Places places(owner);
  EXPECT_TRUE(take(places, 1001, 8));
  EXPECT_EQ(places.take(1001), "user 1001 has 8 clients connected");
  EXPECT_TRUE(take(places, 1002, 8));
  places.leave(1001);
  EXPECT_EQ(places.take(1001), std::nullopt);
}

TEST(Places, LeaveFourToTheAdministrator) {
  Places places(owner);
  EXPECT_TRUE(take(places, owner, 28));
  EXPECT_EQ(places.take(owner), "28 clients are connected, and the last 4 places are reserved for the administrator");
  EXPECT_EQ(places.take(1001), "28 clients are connected, and the last 4 places are reserved for the administrator");
  EXPECT_TRUE(take(places, administrator, 4));
  EXPECT_EQ(places.take(administrator), "32 clients are connected");
}

TEST(Places, AreAllTheAdministratorsWhenNobodyElseComes) {
  Places places(administrator);
  EXPECT_TRUE(take(places, administrator, 32));
  EXPECT_EQ(places.take(administrator), "32 clients are connected");
  EXPECT_EQ(places.taken(), 32U);
}

TEST(Places, GivenBackAreFreeAgain) {
  Places places(owner);
  EXPECT_TRUE(take(places, 1001, 3));
  for (int count = 0; count < 5; ++count) places.leave(1001);  // two more than the user has
  EXPECT_EQ(places.taken(), 0U);
  places.leave(1002);
  EXPECT_EQ(places.taken(), 0U);
}

}  // namespace
}  // namespace vespscope::test
