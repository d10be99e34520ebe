#include "shell/RootNavigationController.h"

#include "client/RhoxWrapper.h"
#include "metrics/MetricValidator.h"
#include "platform/application/System.h"
#include "platform/log/Log.h"

namespace vespscope {
namespace {

// The query for the SIM card files: group 0x7F with the tag of that metric.
constexpr std::int32_t simFilesTriggerRef = 9999;
constexpr std::int32_t simFilesTriggerType = 0;
constexpr std::int32_t simFilesTriggerID = 0x7F0013;

}  // namespace

RootNavigationFields::RootNavigationFields()
    : myRhoxWrapper_(RhoxWrapper::sharedInstance()), myMetricValidator_(MetricValidator::shared()) {}
RootNavigationFields::~RootNavigationFields() = default;

void RootNavigationController::viewDidLoad() {
  NavigationController::viewDidLoad();
  if (myRhoxWrapper_) myRhoxWrapper_->removeOrblConfigForAppid(myAppID_);

  const auto path = application::Bundle::main().pathForResource(metricFileName_, metricFileType_);
  if (!path) {
    log::print("Metric Log File path doesnt exist");
    return;
  }
  log::print("pushing metric file");
  if (!myRhoxWrapper_) log::fatal("there is no wrapper to push the metric configuration through");
  if (!myRhoxWrapper_->addOrblConfigForAppId(myAppID_, path->string())) return;

  if (myMetricValidator_->mySharedRhoxInstance) myMetricValidator_->mySharedRhoxInstance->listen();
  log::print("Querying SIM files");
  if (myRhoxWrapper_) {
    myRhoxWrapper_->querySpecificMetric("vespscope", simFilesTriggerRef, simFilesTriggerType, simFilesTriggerID, 0, 0);
  }
}

void RootNavigationController::didReceiveMemoryWarning() { NavigationController::didReceiveMemoryWarning(); }

}  // namespace vespscope
