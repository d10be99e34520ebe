// The list of screens behind one launch row.
#pragma once

#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "platform/application/TableViewController.h"

namespace vespscope {

class MetricValidator;

class FirstLevelViewController : public application::TableViewController {
 public:
  FirstLevelViewController();

  // The launch row; set before the screen is shown. Without it, or with one that the catalogue does not contain,
  // requesting rows is a programming error.
  std::optional<std::string> seguedThroughRow;
  std::map<std::string, std::vector<std::string>> tableViewFields;
  // Not used here: keeps the decoder reachable from the screen stack.
  std::shared_ptr<MetricValidator> myMetricValidator;

  void viewDidLoad() override;
  [[nodiscard]] std::size_t numberOfRows(std::size_t section) override;
  [[nodiscard]] std::shared_ptr<application::TableCell> cellForRow(application::IndexPath path) override;
  void prepareForSegue(const application::Segue& segue, const application::SegueSender& sender) override;

 private:
  [[nodiscard]] const std::vector<std::string>& rows() const;
};

}  // namespace vespscope
