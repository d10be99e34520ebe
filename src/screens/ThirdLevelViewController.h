// The placeholder for the detail of one second-level row: a single cell as its prototype makes it.
#pragma once

#include <optional>
#include <string>

#include "platform/application/TableViewController.h"
#include "screens/VespViewItems.h"

namespace vespscope {

class ThirdLevelViewController : public application::TableViewController {
 public:
  ThirdLevelViewController();

  // The launch row, the first-level row and the second-level row.
  std::optional<std::string> firstSelection;
  std::optional<std::string> secondSelection;
  std::optional<std::string> seguedThroughRow;
  VespViewItems tableViewFields;

  void viewDidLoad() override;
  void didReceiveMemoryWarning() override;
  [[nodiscard]] std::size_t numberOfSections() override;
  [[nodiscard]] std::size_t numberOfRows(std::size_t section) override;
  [[nodiscard]] std::shared_ptr<application::TableCell> cellForRow(application::IndexPath path) override;
};

}  // namespace vespscope
