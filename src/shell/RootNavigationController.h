// The root controller of the drill-down, which starts the flow of metrics once it has loaded.
#pragma once

#include <memory>
#include <string>

#include "platform/application/NavigationController.h"

namespace vespscope {

class MetricValidator;
class RhoxWrapper;

// The fields of the root controller, initialised before its base: the wrapper's connection is opened before the shared
// decoder is made, and both before any screen exists.
class RootNavigationFields {
 public:
  RootNavigationFields(const RootNavigationFields&) = delete;
  RootNavigationFields& operator=(const RootNavigationFields&) = delete;

  [[nodiscard]] const std::string& myAppID() const { return myAppID_; }
  [[nodiscard]] const std::string& metricFileName() const { return metricFileName_; }
  [[nodiscard]] const std::string& metricFileType() const { return metricFileType_; }
  [[nodiscard]] const std::shared_ptr<RhoxWrapper>& myRhoxWrapper() const { return myRhoxWrapper_; }
  [[nodiscard]] const std::shared_ptr<MetricValidator>& myMetricValidator() const { return myMetricValidator_; }

 protected:
  RootNavigationFields();
  ~RootNavigationFields();

  std::string myAppID_ = "vespscope";
  std::string metricFileName_ = "ice_test_lte";
  std::string metricFileType_ = "deviceconfig";
  std::shared_ptr<RhoxWrapper> myRhoxWrapper_;
  std::shared_ptr<MetricValidator> myMetricValidator_;
};

class RootNavigationController : public RootNavigationFields, public application::NavigationController {
 public:
  using NavigationController::NavigationController;

  // Clears the old metric configuration, pushes the main bundle's, listens and requests the SIM card files.
  void viewDidLoad() override;
  void didReceiveMemoryWarning() override;
};

}  // namespace vespscope
