// The screen stack of a drill-down.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "platform/application/TableViewController.h"

namespace vespscope::application {

class Bundle;
class InterfaceDescription;

// The names of the components that draw the bars above and below a screen; an empty name means the frontend's own.
struct BarClasses {
  std::string navigationBar;
  std::string toolbar;
};

class NavigationController : public ViewController {
 public:
  // Starts with this first screen, which is not loaded here.
  explicit NavigationController(std::shared_ptr<ViewController> rootViewController);
  // Starts without screens.
  explicit NavigationController(BarClasses bars);
  // Starts without screens; `resourceName` in `bundle` (null: the main bundle) describes how the controller's view
  // looks.
  NavigationController(std::string resourceName, const Bundle* bundle);
  // Starts with the first screen that `archive` describes, not loaded.
  explicit NavigationController(const InterfaceDescription& archive);

  // Loads the screen and shows it on top.
  void push(std::shared_ptr<ViewController> screen);
  // Leaves the top screen; the first one stays. Returns false when there was nothing to leave.
  bool pop();

  [[nodiscard]] const std::vector<std::shared_ptr<ViewController>>& viewControllers() const { return stack_; }
  // Null while there is no screen.
  [[nodiscard]] std::shared_ptr<ViewController> topViewController() const;

  [[nodiscard]] const BarClasses& bars() const { return bars_; }
  [[nodiscard]] const std::string& resourceName() const { return resourceName_; }
  [[nodiscard]] const Bundle* bundle() const { return bundle_; }

  // Handles a tap on a row: when its cell's prototype leads to a scene, makes that screen from `interface`, lets
  // `source` prepare the segue with the cell as sender, and pushes the screen. Returns false when the row leads
  // nowhere.
  bool selectRow(const InterfaceDescription& interface, const std::shared_ptr<TableViewController>& source,
                 IndexPath path);

 private:
  std::vector<std::shared_ptr<ViewController>> stack_;
  BarClasses bars_;
  std::string resourceName_;
  const Bundle* bundle_ = nullptr;
};

}  // namespace vespscope::application
