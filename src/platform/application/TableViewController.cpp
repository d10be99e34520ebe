#include "platform/application/TableViewController.h"

#include <utility>

#include "platform/log/Log.h"

namespace vespscope::application {

void ViewController::loadViewIfNeeded() {
  if (loaded_) return;
  loaded_ = true;
  viewDidLoad();
}

void TableView::registerPrototype(CellPrototype prototype) {
  std::string identifier = prototype.identifier;
  prototypes_.insert_or_assign(std::move(identifier), std::move(prototype));
}

std::shared_ptr<TableCell> TableView::dequeueReusableCell(const std::string& identifier, IndexPath /*path*/) {
  const auto found = prototypes_.find(identifier);
  if (found == prototypes_.end()) log::fatal("no cell prototype \"" + identifier + "\"");
  return makeCell(found->second);
}

void TableView::reloadData() { ++reloadCount_; }

}  // namespace vespscope::application
