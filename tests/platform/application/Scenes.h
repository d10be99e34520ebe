// Two screens of rows, for tests of what leads from one to the other.
#pragma once

#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "platform/application/Application.h"

namespace vespscope::test {

// A screen of two rows, one of which leads on, that counts what happens to it.
class Screen : public application::TableViewController {
 public:
  explicit Screen(std::string name) : name_(std::move(name)) {}

  void viewDidLoad() override { ++loads; }
  std::size_t numberOfRows(std::size_t /*section*/) override { return 2; }
  std::shared_ptr<application::TableCell> cellForRow(application::IndexPath path) override {
    auto cell = tableView().dequeueReusableCell(path.row == 0 ? "leads" : "stays", path);
    cell->textLabel->text = name_ + " " + std::to_string(path.row);
    if (cell->detailTextLabel) cell->detailTextLabel->text = "value";
    return cell;
  }
  std::optional<std::string> titleForHeader(std::size_t section) override { return "part " + std::to_string(section); }
  void prepareForSegue(const application::Segue& segue, const application::SegueSender& sender) override {
    ++prepared;
    source = segue.source;
    destination = segue.destination;
    selected = sender.cell;
    destinationLoads = std::dynamic_pointer_cast<Screen>(segue.destination)->loads;
  }

  int loads = 0;
  int destinationLoads = -1;
  int prepared = 0;
  // Of the last segue; weak, because the source of a segue is this screen itself.
  std::weak_ptr<application::ViewController> source;
  std::weak_ptr<application::ViewController> destination;
  std::shared_ptr<application::TableCell> selected;

 private:
  std::string name_;
};

// Two scenes: "first", the initial one, leads to "second".
inline application::InterfaceDescription twoScenes(std::string secondTitle) {
  application::InterfaceDescription interface;
  const std::vector<application::CellPrototype> prototypes = {{"leads", application::CellStyle::basic, true, "second"},
                                                              {"stays", application::CellStyle::value, false, ""}};
  interface.addScene({"first", "Start", prototypes, [] { return std::make_shared<Screen>("first"); }});
  interface.addScene({"second", std::move(secondTitle), prototypes, [] { return std::make_shared<Screen>("second"); }});
  interface.setInitial("first", [](const application::InterfaceDescription& archive) {
    return std::make_shared<application::NavigationController>(archive);
  });
  return interface;
}

inline std::shared_ptr<Screen> top(const application::NavigationController& navigation) {
  return std::dynamic_pointer_cast<Screen>(navigation.topViewController());
}

}  // namespace vespscope::test
