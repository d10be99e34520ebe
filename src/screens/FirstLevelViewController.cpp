#include "screens/FirstLevelViewController.h"

#include "metrics/MetricValidator.h"
#include "platform/log/Log.h"
#include "screens/SecondLevelViewController.h"
#include "screens/SystemBackground.h"
#include "screens/VespViewItems.h"

namespace vespscope {

FirstLevelViewController::FirstLevelViewController()
    : tableViewFields(VespViewItems::shared().firstLevelViewItems), myMetricValidator(MetricValidator::shared()) {}

void FirstLevelViewController::viewDidLoad() {
  TableViewController::viewDidLoad();
  adoptSystemBackground(*this);
}

const std::vector<std::string>& FirstLevelViewController::rows() const {
  if (!seguedThroughRow) log::fatal("a first-level screen was shown without its launch row");
  const auto found = tableViewFields.find(*seguedThroughRow);
  if (found == tableViewFields.end()) log::fatal("the catalogue has no launch row \"" + *seguedThroughRow + "\"");
  return found->second;
}

std::size_t FirstLevelViewController::numberOfRows(std::size_t /*section*/) { return rows().size(); }

std::shared_ptr<application::TableCell> FirstLevelViewController::cellForRow(application::IndexPath path) {
  const std::vector<std::string>& names = rows();
  if (path.row >= names.size()) log::fatal("\"" + *seguedThroughRow + "\" has no row " + std::to_string(path.row));
  auto cell = tableView().dequeueReusableCell("FirstClickView", path);
  if (cell->textLabel) cell->textLabel->text = names[path.row];
  return cell;
}

void FirstLevelViewController::prepareForSegue(const application::Segue& segue,
                                               const application::SegueSender& sender) {
  const auto destination = std::dynamic_pointer_cast<SecondLevelViewController>(segue.destination);
  if (!sender.cell || !destination) return;
  destination->firstSelection = seguedThroughRow;
  destination->seguedThroughRow = application::labelText(*sender.cell);
}

}  // namespace vespscope
