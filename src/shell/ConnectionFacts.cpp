#include "shell/ConnectionFacts.h"

#include <memory>
#include <utility>

#include "client/RhoxWrapper.h"
#include "metrics/MetricValidator.h"
#include "rhoxlink/Rhoxlink.h"
#include "shell/EventRate.h"
#include "shell/SimSwitch.h"

namespace vespscope {
application::StatusProvider statusProvider(std::shared_ptr<const SimSwitch> sims) {
  return [rate = std::make_shared<EventRate>(), sims = std::move(sims)] {
    const auto connection = rhox::client::connectionStatus(RhoxWrapper::sharedInstance()->manager());
    application::Status status;
    status.kind = connection.sourceKind;
    status.source = connection.sourceLabel;
    status.connected = connection.connected;
    status.everConnected = connection.connections > 0;
    status.events = connection.eventsReceived;
    status.eventsPerSecond = rate->update(EventRate::Clock::now(), connection.eventsReceived);
    status.decodeFailures = MetricValidator::shared()->decodeFailures();
    status.eventsLost = connection.eventsLost;
    status.interruptions = connection.connections > 1 ? connection.connections - 1 : 0;
    status.lastEvent = connection.lastEvent;
    status.notSubscribed = connection.notSubscribed;
    status.playback = connection.playback;
    status.problem = connection.problem;
    if (sims) status.sims = sims->cards();
    return status;
  };
}

}  // namespace vespscope
