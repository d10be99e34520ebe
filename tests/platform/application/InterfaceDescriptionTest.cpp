// Scenes that an interface description does not have.
#include <gtest/gtest.h>

#include "Scenes.h"

namespace vespscope::test {
namespace {

using namespace application;

TEST(InterfaceDescription, StopsTheProgramForAnUnknownScene) {
  EXPECT_DEATH((void)twoScenes("").instantiate("third"), "fatal: no scene \"third\" in the interface description");
  EXPECT_DEATH((void)InterfaceDescription().instantiateInitial(), "fatal: the interface description has no initial");
}

}  // namespace
}  // namespace vespscope::test
