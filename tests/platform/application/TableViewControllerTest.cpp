// A screen is loaded once and counts its reloads.
#include <gtest/gtest.h>

#include "Scenes.h"

namespace vespscope::test {
namespace {

using namespace application;

TEST(TableViewController, IsLoadedOnce) {
  Screen screen("any");
  screen.loadViewIfNeeded();
  screen.loadViewIfNeeded();
  EXPECT_EQ(screen.loads, 1);
}

TEST(TableViewController, CountsReloads) {
  Screen screen("any");
  EXPECT_EQ(screen.tableView().reloadCount(), 0U);
  screen.tableView().reloadData();
  EXPECT_EQ(screen.tableView().reloadCount(), 1U);
}

}  // namespace
}  // namespace vespscope::test
