#include "screens/VespViewController.h"

#include "platform/log/Log.h"
#include "screens/FirstLevelViewController.h"
#include "screens/SystemBackground.h"
#include "screens/VespViewItems.h"

namespace vespscope {

void VespViewController::viewDidLoad() {
  TableViewController::viewDidLoad();
  tableView().setEmptyFooter();
  adoptSystemBackground(*this);
}

void VespViewController::didReceiveMemoryWarning() { TableViewController::didReceiveMemoryWarning(); }

std::size_t VespViewController::numberOfSections() { return 1; }

std::size_t VespViewController::numberOfRows(std::size_t /*section*/) {
  return VespViewItems::shared().launchViewItemNames.size();
}

std::shared_ptr<application::TableCell> VespViewController::cellForRow(application::IndexPath path) {
  const VespViewItems::Rows& names = VespViewItems::shared().launchViewItemNames;
  if (path.row >= names.size()) log::fatal("the launch screen has no row " + std::to_string(path.row));
  auto cell = tableView().dequeueReusableCell("LaunchView", path);
  if (cell->textLabel) cell->textLabel->text = names[path.row];
  return cell;
}

void VespViewController::prepareForSegue(const application::Segue& segue, const application::SegueSender& sender) {
  const auto destination = std::dynamic_pointer_cast<FirstLevelViewController>(segue.destination);
  if (!sender.cell || !destination) return;
  destination->seguedThroughRow = application::labelText(*sender.cell);
}

}  // namespace vespscope
