// The launch screen: device and technologies, each leading to its list of screens.
#pragma once

#include "platform/application/TableViewController.h"

namespace vespscope {

class VespViewController : public application::TableViewController {
 public:
  void viewDidLoad() override;
  void didReceiveMemoryWarning() override;

  [[nodiscard]] std::size_t numberOfSections() override;
  [[nodiscard]] std::size_t numberOfRows(std::size_t section) override;
  [[nodiscard]] std::shared_ptr<application::TableCell> cellForRow(application::IndexPath path) override;
  void prepareForSegue(const application::Segue& segue, const application::SegueSender& sender) override;
};

}  // namespace vespscope
