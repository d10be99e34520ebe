// Receives the baseband manager's events from the wrapper, on the main queue.
#pragma once

#include <memory>

#include "values/Value.h"

namespace vespscope {

class RhoxWrapperDelegate {
 public:
  virtual ~RhoxWrapperDelegate() = default;
  // Each event of the trigger kind.
  virtual void eventsDidUpdate(std::shared_ptr<const Record> dictionary) = 0;
  // Each event of the metric kind; the dictionary holds "kKeyMetricID", "kKeyPayload" and "kKeyProfileID".
  virtual void metricsDidUpdate(std::shared_ptr<const Record> dictionary) = 0;
};

}  // namespace vespscope
