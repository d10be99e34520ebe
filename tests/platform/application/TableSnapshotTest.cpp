// A screen as frontends read it.
#include <gtest/gtest.h>

#include "Scenes.h"
#include "platform/application/TableSnapshot.h"

namespace vespscope::test {
namespace {

using namespace application;

TEST(TableSnapshot, HoldsTitlesLabelsValuesAndMarks) {
  const auto screen = twoScenes("").instantiate("first");
  const TableSnapshot expected = {{{"part 0", {{"first 0", std::nullopt, true}, {"first 1", "value", false}}}}};
  EXPECT_EQ(readTable(*screen), expected);
}

}  // namespace
}  // namespace vespscope::test
