// Screens pushed and popped, and rows that lead to others.
#include <memory>
#include <string>

#include <gtest/gtest.h>

#include "Scenes.h"

namespace vespscope::test {
namespace {

using namespace application;

TEST(NavigationController, TheInitialControllerHoldsTheRootScreenNotLoaded) {
  const auto navigation = twoScenes("").instantiateInitial();
  ASSERT_EQ(navigation->viewControllers().size(), 1U);
  EXPECT_EQ(navigation->topViewController()->title(), "Start");
  EXPECT_EQ(top(*navigation)->loads, 0);
}

TEST(NavigationController, EachInitialiserKeepsWhatItIsGiven) {
  const auto screen = std::make_shared<Screen>("root");
  EXPECT_EQ(NavigationController(screen).topViewController(), screen);
  const NavigationController barred(BarClasses{"Top", "Bottom"});
  EXPECT_EQ(barred.bars().navigationBar, "Top");
  EXPECT_EQ(barred.bars().toolbar, "Bottom");
  EXPECT_EQ(barred.topViewController(), nullptr);
  const NavigationController fromResource("Main", nullptr);
  EXPECT_EQ(fromResource.resourceName(), "Main");
  EXPECT_EQ(fromResource.bundle(), nullptr);
}

TEST(NavigationController, PushingLoadsAndPoppingKeepsTheFirstScreen) {
  const auto navigation = twoScenes("").instantiateInitial();
  const auto pushed = std::make_shared<Screen>("pushed");
  navigation->push(pushed);
  EXPECT_EQ(pushed->loads, 1);
  EXPECT_EQ(navigation->topViewController(), pushed);
  EXPECT_TRUE(navigation->pop());
  EXPECT_FALSE(navigation->pop());
  EXPECT_EQ(navigation->viewControllers().size(), 1U);
}

TEST(NavigationController, SelectingARowPreparesTheDestinationBeforeItLoads) {
  const InterfaceDescription interface = twoScenes("");
  const auto navigation = interface.instantiateInitial();
  const auto source = top(*navigation);
  ASSERT_TRUE(navigation->selectRow(interface, source, {0, 0}));
  ASSERT_EQ(source->prepared, 1);
  EXPECT_EQ(source->source.lock(), source);
  EXPECT_EQ(source->destination.lock(), navigation->topViewController());
  ASSERT_TRUE(source->selected);
  EXPECT_EQ(source->selected->textLabel->text, "first 0");
  EXPECT_EQ(source->destinationLoads, 0);
  EXPECT_EQ(top(*navigation)->loads, 1);
}

TEST(NavigationController, TheRowNamesADestinationWhoseSceneHasNoTitle) {
  const InterfaceDescription untitled = twoScenes("");
  const auto navigation = untitled.instantiateInitial();
  navigation->selectRow(untitled, top(*navigation), {0, 0});
  EXPECT_EQ(navigation->topViewController()->title(), "first 0");
}

TEST(NavigationController, ASceneTitleNamesTheDestination) {
  const InterfaceDescription titled = twoScenes("Details");
  const auto navigation = titled.instantiateInitial();
  navigation->selectRow(titled, top(*navigation), {0, 0});
  EXPECT_EQ(navigation->topViewController()->title(), "Details");
}

TEST(NavigationController, ARowWithoutASegueLeadsNowhere) {
  const InterfaceDescription interface = twoScenes("");
  const auto navigation = interface.instantiateInitial();
  EXPECT_FALSE(navigation->selectRow(interface, top(*navigation), {0, 1}));
  EXPECT_EQ(navigation->viewControllers().size(), 1U);
}

}  // namespace
}  // namespace vespscope::test
