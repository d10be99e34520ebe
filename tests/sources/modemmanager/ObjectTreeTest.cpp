// The tree of the service's objects, as signals change it.

#include <gtest/gtest.h>

#include "Properties.h"
#include "sources/modemmanager/ObjectTree.h"

namespace vespscope::test {
namespace {

using namespace sources::modemmanager;

TEST(ObjectTree, ForgetsWhatIsInvalidatedAndLeavesUnknownObjectsAlone) {
  ObjectTree tree;
  tree.set("/a", "i", dictionary({{"one", number(1)}, {"two", number(2)}}));
  tree.change("/a", "i", dictionary({{"two", number(3)}}), {text("one")});
  EXPECT_EQ(tree.at("/a", "i").number("one"), std::nullopt);
  EXPECT_EQ(tree.at("/a", "i").number("two"), 3U);
  tree.change("/b", "i", dictionary({{"one", number(1)}}), {});
  EXPECT_FALSE(tree.has("/b", "i"));
  tree.remove("/a", {text("i")});
  EXPECT_FALSE(tree.has("/a", "i"));
}

}  // namespace
}  // namespace vespscope::test
