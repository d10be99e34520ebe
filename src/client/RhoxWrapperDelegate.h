// Receives the baseband manager's events from the wrapper, on the main queue.
#pragma once

#include <memory>

#include "values/Value.h"

namespace vespscope {

class RhoxWrapperDelegate {
 public:
  virtual ~RhoxWrapperDelegate() = default;
  // Called with each event of the trigger kind.
  virtual void eventsDidUpdate(std::shared_ptr<const Record> dictionary) = 0;
  // Called with each event of the metric kind; the dictionary has "kKeyMetricID", "kKeyPayload" and "kKeyProfileID".
  virtual void metricsDidUpdate(std::shared_ptr<const Record> dictionary) = 0;
};

}  // namespace vespscope
