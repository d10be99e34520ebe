// The background of the screens follows the platform's version.
#include <gtest/gtest.h>

#include "platform/application/System.h"
#include "screens/FirstLevelViewController.h"
#include "screens/Screens.h"
#include "screens/SecondLevelViewController.h"
#include "screens/ThirdLevelViewController.h"
#include "screens/VespViewController.h"

namespace vespscope::test {
namespace {

using application::CellStyle;
using application::Colour;

TEST(SystemBackground, IsLeftAloneOnAPlatformOlderThanThirteen) {
  application::setPlatformVersion({12, 5, 7});
  const std::vector<std::shared_ptr<application::ViewController>> screens = {
      launchScreen(), firstLevel("LTE"), secondLevel("LTE", "NAS"),
      makeScreen<ThirdLevelViewController>("ThirdClickView", CellStyle::basic)};
  for (const auto& screen : screens) {
    screen->loadViewIfNeeded();
    EXPECT_FALSE(screen->backgroundColour());
  }
}

TEST(SystemBackground, IsTheSystemsFromThirteenOn) {
  application::setPlatformVersion({13, 0, 0});
  const std::vector<std::shared_ptr<application::ViewController>> screens = {
      launchScreen(), firstLevel("LTE"), secondLevel("LTE", "NAS"),
      makeScreen<ThirdLevelViewController>("ThirdClickView", CellStyle::basic)};
  for (const auto& screen : screens) {
    screen->loadViewIfNeeded();
    EXPECT_EQ(screen->backgroundColour(), Colour::systemBackground);
  }
}

}  // namespace
}  // namespace vespscope::test
