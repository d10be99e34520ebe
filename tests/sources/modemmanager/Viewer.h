// The viewer without an interface in this process: the start of the application, its decoder and its screens, with a
// manager inside the process.
#pragma once

#include <chrono>
#include <cstdlib>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "client/RhoxWrapper.h"
#include "manager/embedded/EmbeddedManagers.h"
#include "metrics/MetricValidator.h"
#include "platform/application/TableSnapshot.h"
#include "platform/dispatch/MainLoop.h"
#include "rhoxlink/Rhoxlink.h"
#include "screens/SecondLevelViewController.h"
#include "shell/MainInterface.h"
#include "shell/RootNavigationController.h"

namespace vespscope::test {

class Viewer {
 public:
  using Duration = std::chrono::milliseconds;

  // Starts with a manager whose source is that of `words`.
  explicit Viewer(const std::string& words) {
    ::setenv("TZ", "UTC", 1);
    ::setenv("VESPSCOPE_RESOURCES", VESPSCOPE_SOURCE_DIR "/resources", 1);
    rhox::client::setEmbeddedFactory(managers_.factory());
    rhox::client::setAddress(rhox::client::Address::parse("embedded:" + words).value());
    navigation_ = mainInterface().instantiateInitial();
    navigation_->loadViewIfNeeded();
  }

  // Runs the main loop until `condition` holds, and returns how long that took; empty on a timeout.
  static std::optional<Duration> runUntil(const std::function<bool()>& condition,
                                          Duration limit = std::chrono::seconds(30)) {
    const auto begin = std::chrono::steady_clock::now();
    while (!condition()) {
      if (std::chrono::steady_clock::now() - begin > limit) return std::nullopt;
      dispatch::MainLoop::main().runOnce(std::chrono::milliseconds(10));
    }
    return std::chrono::duration_cast<Duration>(std::chrono::steady_clock::now() - begin);
  }

  // The contents of a screen, section by section.
  static application::TableSnapshot screen(const std::string& launch, const std::string& row) {
    auto controller = std::make_shared<SecondLevelViewController>();
    controller->tableView().registerPrototype({"SecondClickView", application::CellStyle::value, false, ""});
    controller->firstSelection = launch;
    controller->seguedThroughRow = row;
    return application::readTable(*controller);
  }

  // The value next to `label`, in the first section with such a row.
  static std::string value(const std::string& launch, const std::string& row, const std::string& label) {
    for (const auto& section : screen(launch, row).sections) {
      for (const auto& each : section.rows) {
        if (each.label == label) return each.value.value_or("");
      }
    }
    return "(no row)";
  }

  // The labels of a screen's rows, one after the other.
  static std::string labels(const std::string& launch, const std::string& row) {
    std::string all;
    for (const auto& section : screen(launch, row).sections) {
      for (const auto& each : section.rows) all += (all.empty() ? "" : " ") + each.label;
    }
    return all;
  }

  static std::string sourceLabel() {
    return rhox::client::connectionStatus(RhoxWrapper::sharedInstance()->manager()).sourceLabel;
  }

 private:
  manager::EmbeddedManagers managers_;
  std::shared_ptr<application::NavigationController> navigation_;
};

}  // namespace vespscope::test
