// The screen stack of a drill-down.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "platform/application/TableViewController.h"

namespace vespscope::application {

class Bundle;
class InterfaceDescription;

// The components by name that draw the bars above and below a screen; an empty name is the frontend's own.
struct BarClasses {
  std::string navigationBar;
  std::string toolbar;
};

class NavigationController : public ViewController {
 public:
  // With its first screen, which is not loaded by this alone.
  explicit NavigationController(std::shared_ptr<ViewController> rootViewController);
  // Without screens.
  explicit NavigationController(BarClasses bars);
  // Without screens; `resourceName` in `bundle` (null: the main bundle) tells how its view looks.
  NavigationController(std::string resourceName, const Bundle* bundle);
  // With the first screen that `archive` describes, not loaded.
  explicit NavigationController(const InterfaceDescription& archive);

  // Loads the screen and shows it on top.
  void push(std::shared_ptr<ViewController> screen);
  // Leaves the top screen; the first one stays. False when there was nothing to leave.
  bool pop();

  [[nodiscard]] const std::vector<std::shared_ptr<ViewController>>& viewControllers() const { return stack_; }
  // Null while there is no screen.
  [[nodiscard]] std::shared_ptr<ViewController> topViewController() const;

  [[nodiscard]] const BarClasses& bars() const { return bars_; }
  [[nodiscard]] const std::string& resourceName() const { return resourceName_; }
  [[nodiscard]] const Bundle* bundle() const { return bundle_; }

  // What a tap on a row does: when its cell's prototype leads to a scene, makes that screen from `interface`, lets
  // `source` prepare the segue with the cell as sender, and pushes. False when the row leads nowhere.
  bool selectRow(const InterfaceDescription& interface, const std::shared_ptr<TableViewController>& source,
                 IndexPath path);

 private:
  std::vector<std::shared_ptr<ViewController>> stack_;
  BarClasses bars_;
  std::string resourceName_;
  const Bundle* bundle_ = nullptr;
};

}  // namespace vespscope::application
