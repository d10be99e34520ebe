#include "screens/ThirdLevelViewController.h"

#include "screens/SystemBackground.h"

namespace vespscope {

ThirdLevelViewController::ThirdLevelViewController() : tableViewFields(VespViewItems::shared()) {}

void ThirdLevelViewController::viewDidLoad() {
  TableViewController::viewDidLoad();
  adoptSystemBackground(*this);
}

void ThirdLevelViewController::didReceiveMemoryWarning() { TableViewController::didReceiveMemoryWarning(); }

std::size_t ThirdLevelViewController::numberOfSections() { return 1; }
std::size_t ThirdLevelViewController::numberOfRows(std::size_t /*section*/) { return 1; }

std::shared_ptr<application::TableCell> ThirdLevelViewController::cellForRow(application::IndexPath path) {
  return tableView().dequeueReusableCell("ThirdClickView", path);
}

}  // namespace vespscope
