#include "messages/DataBearers.h"

#include "messages/WireReader.h"
#include "messages/mobility/KCellularActivatedBearerContexts.h"
#include "registry/MetricRows.h"

namespace vespscope {

bool reportsDataBearers(std::int64_t metricID, const Bytes& payload) {
  if (metricID != metricIdentifier("K_CELLULAR_ACTIVE_BEARER")) return false;
  KCellularActivatedBearerContexts message;
  WireReader reader(payload);
  return message.readFrom(reader) && message.bearerContextsCount() > 0;
}

}  // namespace vespscope
