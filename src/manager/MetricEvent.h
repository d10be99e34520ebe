// The metric event under the manager's own name.
#pragma once

#include "values/MetricEvent.h"

namespace vespscope::manager {

using vespscope::MetricEvent;

}  // namespace vespscope::manager
