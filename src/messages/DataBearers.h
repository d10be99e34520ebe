// Finds out whether a metric event reports data bearers, which shows that its SIM card is the active one in data.
#pragma once

#include <cstdint>

#include "values/Value.h"

namespace vespscope {

// Whether `payload` is a report of the active bearers with at least one of them.
[[nodiscard]] bool reportsDataBearers(std::int64_t metricID, const Bytes& payload);

}  // namespace vespscope
