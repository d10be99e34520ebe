// The screen stack of a drill-down.
#pragma once

#include <functional>
#include <memory>
#include <vector>

#include "platform/application/TableViewController.h"

namespace vespscope::application {

class InterfaceDescription;

class NavigationController : public ViewController {
 public:
  // Loads the screen and shows it on top.
  void push(std::shared_ptr<ViewController> screen);
  // Leaves the top screen; the first one stays. False when there was nothing to leave.
  bool pop();

  [[nodiscard]] const std::vector<std::shared_ptr<ViewController>>& viewControllers() const { return stack_; }
  [[nodiscard]] std::shared_ptr<ViewController> topViewController() const;

  // What a tap on a row does: when its cell's prototype leads to a scene, makes that screen from `interface`, lets
  // `source` prepare the segue with the cell as sender, and pushes. False when the row leads nowhere.
  bool selectRow(const InterfaceDescription& interface, const std::shared_ptr<TableViewController>& source,
                 IndexPath path);

 private:
  std::vector<std::shared_ptr<ViewController>> stack_;
};

}  // namespace vespscope::application
