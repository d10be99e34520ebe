// The interface description: which scenes exist, how their cells look, and what their rows lead to.
#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "platform/application/NavigationController.h"

namespace vespscope::application {

struct Scene {
  std::string identifier;
  std::string title;  // empty: the label of the row that led here names the screen
  std::vector<CellPrototype> prototypes;
  std::function<std::shared_ptr<TableViewController>()> create;
};

class InterfaceDescription {
 public:
  void addScene(Scene scene);
  // The navigation controller that holds the first screen.
  void setInitial(std::string rootScene, std::function<std::shared_ptr<NavigationController>()> createNavigation);

  // A screen of the scene with its prototypes and title; an unknown identifier is a programming error.
  [[nodiscard]] std::shared_ptr<TableViewController> instantiate(const std::string& identifier) const;
  // The navigation controller with its root screen pushed; neither is loaded yet by this call alone.
  [[nodiscard]] std::shared_ptr<NavigationController> instantiateInitial() const;

 private:
  std::vector<Scene> scenes_;
  std::string rootScene_;
  std::function<std::shared_ptr<NavigationController>()> createNavigation_;
};

}  // namespace vespscope::application
