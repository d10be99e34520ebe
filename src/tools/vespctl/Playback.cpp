#include "tools/vespctl/Playback.h"

#include <memory>
#include <utility>

#include "metrics/MetricValidator.h"
#include "shell/SimChoice.h"
#include "tools/vespctl/Input.h"

namespace vespscope::tools {

Problem playInto(MetricValidator& validator, Input& input) {
  SimChoice choice({.forget = [&validator] { validator.forget(); },
                    .pass = [&validator](SimChoice::Event event) { validator.metricsDidUpdate(std::move(event)); }},
                   std::nullopt);
  while (std::optional<MetricEvent> event = input.next()) {
    choice.take(std::make_shared<const Record>(Record{{Key(validator.metricIDKey), event->metricID},
                                                      {Key(validator.payloadKey), std::move(event->payload)},
                                                      {Key(validator.profileIDKey), event->profileID}}),
                {});
  }
  return input.problem();
}

}  // namespace vespscope::tools
