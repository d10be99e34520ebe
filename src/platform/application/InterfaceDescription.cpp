#include "platform/application/InterfaceDescription.h"

#include <algorithm>
#include <utility>

#include "platform/log/Log.h"

namespace vespscope::application {

void InterfaceDescription::addScene(Scene scene) { scenes_.push_back(std::move(scene)); }

void InterfaceDescription::setInitial(std::string rootScene, CreateNavigation createNavigation) {
  rootScene_ = std::move(rootScene);
  createNavigation_ = std::move(createNavigation);
}

std::shared_ptr<TableViewController> InterfaceDescription::instantiate(const std::string& identifier) const {
  const auto scene = std::find_if(scenes_.begin(), scenes_.end(),
                                  [&identifier](const Scene& known) { return known.identifier == identifier; });
  if (scene == scenes_.end()) log::fatal("no scene \"" + identifier + "\" in the interface description");
  std::shared_ptr<TableViewController> screen = scene->create();
  for (const CellPrototype& prototype : scene->prototypes) screen->tableView().registerPrototype(prototype);
  screen->setTitle(scene->title);
  return screen;
}

std::shared_ptr<NavigationController> InterfaceDescription::instantiateInitial() const {
  if (!createNavigation_) log::fatal("the interface description has no initial navigation controller");
  return createNavigation_(*this);
}

}  // namespace vespscope::application
