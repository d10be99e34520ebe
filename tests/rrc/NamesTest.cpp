// Names of definitions, found by their spelling.
#include <gtest/gtest.h>

#include "rrc/Names.h"

namespace vespscope::test {
namespace {

using namespace rrc;

TEST(Names, AreFoundByTheirSpelling) {
  for (std::size_t id = 0; id < nameCount; ++id) {
    ASSERT_EQ(findName(nameOf(static_cast<NameId>(id))), static_cast<NameId>(id));
  }
  EXPECT_EQ(nameOf("rrcConnectionRelease"_name), "rrcConnectionRelease");
  EXPECT_FALSE(findName("rrcConnectionRelief"));
  EXPECT_FALSE(findName("~"));
}

}  // namespace
}  // namespace vespscope::test
