// The screen of one metric group: rows with a label and a value, read again every five seconds.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>

#include "platform/application/TableViewController.h"
#include "screens/VespViewItems.h"

namespace vespscope {

class MetricValidator;
class Record;
struct ScreenSource;

class SecondLevelViewController : public application::TableViewController {
 public:
  SecondLevelViewController();

  VespViewItems tableViewFields;
  // The launch row and the first-level row; set before the screen is shown. Without them, every data-source operation
  // is a programming error.
  std::optional<std::string> firstSelection;
  std::optional<std::string> seguedThroughRow;
  // The last filled cell.
  std::shared_ptr<application::TableCell> currentCell;
  std::shared_ptr<MetricValidator> myMetricValidator;

  // Starts the refresh, which is never stopped: its timer keeps the screen alive and reloading after the user has left
  // it.
  void viewDidLoad() override;

  [[nodiscard]] std::size_t numberOfSections() override;
  [[nodiscard]] std::size_t numberOfRows(std::size_t section) override;
  [[nodiscard]] std::shared_ptr<application::TableCell> cellForRow(application::IndexPath path) override;
  // Sections are numbered from 1.
  [[nodiscard]] std::optional<std::string> titleForHeader(std::size_t section) override;
  [[nodiscard]] double heightForRow(application::IndexPath path) override;
  [[nodiscard]] double estimatedHeightForRow(application::IndexPath path) override;

  // The identifier of the metric whose latest report the screen shows; empty for a screen that no report fills.
  [[nodiscard]] std::optional<std::int64_t> metric() const;

  // The timer's action: queues a reload of the table.
  void update();

 private:
  [[nodiscard]] std::string screenKey() const;
  // The record that a section shows; null if there is none yet.
  [[nodiscard]] const Record* recordOf(const ScreenSource& source, std::size_t section) const;
};

}  // namespace vespscope
