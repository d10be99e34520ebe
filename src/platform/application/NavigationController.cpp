#include "platform/application/NavigationController.h"

#include <utility>

#include "platform/application/InterfaceDescription.h"

namespace vespscope::application {

NavigationController::NavigationController(std::shared_ptr<ViewController> rootViewController)
    : stack_{std::move(rootViewController)} {}
NavigationController::NavigationController(BarClasses bars) : bars_(std::move(bars)) {}
NavigationController::NavigationController(std::string resourceName, const Bundle* bundle)
    : resourceName_(std::move(resourceName)), bundle_(bundle) {}
NavigationController::NavigationController(const InterfaceDescription& archive)
    : NavigationController(archive.instantiate(archive.rootScene())) {}

void NavigationController::push(std::shared_ptr<ViewController> screen) {
  screen->loadViewIfNeeded();
  stack_.push_back(std::move(screen));
}

bool NavigationController::pop() {
  if (stack_.size() < 2) return false;
  stack_.pop_back();
  return true;
}

std::shared_ptr<ViewController> NavigationController::topViewController() const {
  return stack_.empty() ? nullptr : stack_.back();
}

bool NavigationController::selectRow(const InterfaceDescription& interface,
                                     const std::shared_ptr<TableViewController>& source, IndexPath path) {
  const std::shared_ptr<TableCell> cell = source->cellForRow(path);
  if (cell->segueTo.empty()) return false;
  const std::shared_ptr<TableViewController> destination = interface.instantiate(cell->segueTo);
  if (destination->title().empty()) destination->setTitle(labelText(*cell).value_or(std::string()));
  source->prepareForSegue({source, destination}, {cell});
  push(destination);
  return true;
}

}  // namespace vespscope::application
