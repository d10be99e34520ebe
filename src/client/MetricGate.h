// Stands between the metric events that arrive and the wrapper's delegate.
#pragma once

#include <functional>
#include <memory>

#include "values/Value.h"

namespace vespscope {

class MetricGate {
 public:
  // Hands one event's dictionary to the delegate on the main queue; called on the wrapper's serial queue.
  using Pass = std::function<void(std::shared_ptr<const Record> dictionary)>;

  virtual ~MetricGate() = default;
  // Called on the wrapper's serial queue with each event, in order. `pass` may be kept and called later.
  virtual void take(std::shared_ptr<const Record> dictionary, const Pass& pass) = 0;
};

}  // namespace vespscope
