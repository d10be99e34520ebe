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
  std::string title;  // if empty, the screen is named by the label of the row that led here
  std::vector<CellPrototype> prototypes;
  std::function<std::shared_ptr<TableViewController>()> create;
};

class InterfaceDescription {
 public:
  void addScene(Scene scene);
  // The scene of the first screen, and the navigation controller that will hold it.
  using CreateNavigation = std::function<std::shared_ptr<NavigationController>(const InterfaceDescription&)>;
  void setInitial(std::string rootScene, CreateNavigation createNavigation);
  [[nodiscard]] const std::string& rootScene() const { return rootScene_; }

  // Makes a screen of the scene with its prototypes and title; an unknown identifier is a programming error.
  [[nodiscard]] std::shared_ptr<TableViewController> instantiate(const std::string& identifier) const;
  // Makes the navigation controller with its first screen on it, neither of them loaded; a call before `setInitial` is
  // a programming error.
  [[nodiscard]] std::shared_ptr<NavigationController> instantiateInitial() const;

 private:
  std::vector<Scene> scenes_;
  std::string rootScene_;
  CreateNavigation createNavigation_;
};

}  // namespace vespscope::application
