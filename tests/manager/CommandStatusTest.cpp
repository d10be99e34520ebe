// The statuses of commands and their texts.
#include <set>

#include <gtest/gtest.h>

#include "manager/CommandStatus.h"
#include "rhoxlink/bus/Names.h"

namespace vespscope::test {
namespace {

TEST(CommandStatus, HasATextForEachValue) {
  std::set<manager::CommandStatus> seen;
  for (const auto& [status, text] : manager::commandStatusTexts) {
    EXPECT_TRUE(seen.insert(status).second);
    EXPECT_EQ(text.empty(), status == manager::CommandStatus::ok);
  }
  // Consecutive from 0: a status without a text would leave a gap or come after the last one.
  std::int32_t expected = 0;
  for (const manager::CommandStatus status : seen) EXPECT_EQ(static_cast<std::int32_t>(status), expected++);
  EXPECT_EQ(*seen.rbegin(), manager::CommandStatus::noPlace);
  EXPECT_EQ(static_cast<std::int32_t>(manager::CommandStatus::noPlace), rhox::kStatusNoPlace);
}

}  // namespace
}  // namespace vespscope::test
