// Each kind of fault has its text.
#include <gtest/gtest.h>

#include "rrc/Fault.h"

namespace vespscope::test {
namespace {

using namespace rrc;

TEST(Fault, HasATextForEachKind) {
  for (std::size_t kind = 0; kind < faultKindCount; ++kind) {
    EXPECT_FALSE(textOf(static_cast<FaultKind>(kind)).empty());
  }
}

}  // namespace
}  // namespace vespscope::test
