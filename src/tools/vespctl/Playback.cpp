#include "tools/vespctl/Playback.h"

#include "capture/CaptureReader.h"
#include "metrics/MetricValidator.h"

namespace vespscope::tools {

Problem playInto(MetricValidator& validator, capture::CaptureReader& reader) {
  for (;;) {
    Result<std::optional<MetricEvent>> event = reader.next();
    if (!event) return event.reason();
    if (!*event) return std::nullopt;
    validator.metricsDidUpdate(
        std::make_shared<const Record>(Record{{Key(validator.metricIDKey), (*event)->metricID},
                                              {Key(validator.payloadKey), std::move((*event)->payload)},
                                              {Key(validator.profileIDKey), (*event)->profileID}}));
  }
}

}  // namespace vespscope::tools
