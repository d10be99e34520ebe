#include "shell/MainInterface.h"

#include "screens/FirstLevelViewController.h"
#include "screens/SecondLevelViewController.h"
#include "screens/ThirdLevelViewController.h"
#include "screens/VespViewController.h"
#include "shell/RootNavigationController.h"

namespace vespscope {
namespace {

template <class Screen>
application::Scene scene(std::string identifier, std::string title, application::CellPrototype prototype) {
  return {std::move(identifier), std::move(title), {std::move(prototype)}, [] { return std::make_shared<Screen>(); }};
}

}  // namespace

application::InterfaceDescription mainInterface() {
  using application::CellStyle;
  application::InterfaceDescription interface;
  interface.addScene(
      scene<VespViewController>("launch", "vespscope", {"LaunchView", CellStyle::basic, true, "firstLevel"}));
  interface.addScene(
      scene<FirstLevelViewController>("firstLevel", "", {"FirstClickView", CellStyle::basic, true, "secondLevel"}));
  interface.addScene(
      scene<SecondLevelViewController>("secondLevel", "", {"SecondClickView", CellStyle::value, false, ""}));
  // No row leads here yet: there is no detail beyond a second-level row.
  interface.addScene(
      scene<ThirdLevelViewController>("thirdLevel", "", {"ThirdClickView", CellStyle::basic, false, ""}));
  interface.setInitial("launch", [](const application::InterfaceDescription& archive) {
    return std::make_shared<RootNavigationController>(archive);
  });
  return interface;
}

}  // namespace vespscope
