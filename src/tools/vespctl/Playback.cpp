#include "tools/vespctl/Playback.h"

#include <memory>
#include <utility>

#include "metrics/MetricValidator.h"
#include "tools/vespctl/Input.h"

namespace vespscope::tools {

Problem playInto(MetricValidator& validator, Input& input) {
  while (std::optional<MetricEvent> event = input.next()) {
    validator.metricsDidUpdate(
        std::make_shared<const Record>(Record{{Key(validator.metricIDKey), event->metricID},
                                              {Key(validator.payloadKey), std::move(event->payload)},
                                              {Key(validator.profileIDKey), event->profileID}}));
  }
  return input.problem();
}

}  // namespace vespscope::tools
