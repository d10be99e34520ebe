#include "shell/ScreenAges.h"

#include <memory>

#include "client/RhoxWrapper.h"
#include "metrics/MetricValidator.h"
#include "platform/dispatch/MainLoop.h"
#include "rhoxlink/Rhoxlink.h"
#include "screens/SecondLevelViewController.h"
#include "shell/MetricAges.h"
#include "shell/SimSwitch.h"

namespace vespscope {
namespace {

// The report's own time.
std::optional<std::chrono::nanoseconds> ownTime(const Record& report) {
  const Value* timestamp = report.find("timestamp");
  const std::optional<double> milliseconds = timestamp == nullptr ? std::nullopt : timestamp->asDouble();
  constexpr double limit = 9e12;  // ms, in the year 2255: nanoseconds since 1970 do not overflow
  if (!milliseconds || !(*milliseconds > 0 && *milliseconds < limit)) return std::nullopt;
  return std::chrono::nanoseconds(static_cast<std::int64_t>(*milliseconds * 1e6));
}

}  // namespace

application::ScreenAgeProvider screenAgeProvider(const std::shared_ptr<SimSwitch>& sims) {
  auto ages = std::make_shared<MetricAges>();
  if (sims) sims->onForget([ages] { *ages = MetricAges(); });
  // The decoder is made with the first screen, and the order of start-up steps is fixed.
  dispatch::MainLoop::main().async([ages, sims] {
    MetricValidator::shared()->setObserver([ages, sims](std::int64_t identifier, const Record& report) {
      // A report that is shown again after a switch is as old as it was.
      const auto arrival = sims ? sims->arrivalOf(identifier) : std::nullopt;
      ages->note(identifier, ownTime(report), arrival.value_or(MetricAges::Clock::now()));
    });
  });
  return [ages](const application::ViewController& screen) -> std::optional<application::ScreenAge> {
    const auto* shown = dynamic_cast<const SecondLevelViewController*>(&screen);
    const std::optional<std::int64_t> metric = shown == nullptr ? std::nullopt : shown->metric();
    if (!metric) return std::nullopt;
    const auto connection = rhox::client::connectionStatus(RhoxWrapper::sharedInstance()->manager());
    MetricAges::Source source;
    source.connected = connection.connected;
    source.recorded = connection.sourceKind == SourceKind::recorded;
    if (connection.playback) source.recordingClock = connection.playback->clock;
    return ages->ageOf(*metric, source, MetricAges::Clock::now());
  };
}

}  // namespace vespscope
