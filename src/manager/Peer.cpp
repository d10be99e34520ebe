#include "manager/Peer.h"

#include "manager/Commands.h"

namespace vespscope::manager {
namespace {

ipc::Dictionary toDictionary(const SharedEvent& event, bool withTime) {
  ipc::Dictionary dictionary;
  dictionary.reserve(withTime ? 4 : 3);
  dictionary.set(rhox::kKeyMetricID, ipc::Object(std::int64_t{event->metricID}));
  dictionary.set(rhox::kKeyPayload, ipc::Object(ipc::SharedBytes(event, &event->payload)));
  dictionary.set(rhox::kKeyProfileID, ipc::Object(std::int64_t{event->profileID}));
  if (withTime) dictionary.set(rhox::kKeyTime, ipc::Object(std::int64_t{event->time.count()}));
  return dictionary;
}

}  // namespace

std::optional<std::string> Peer::takePlace() {
  if (place_) return std::nullopt;
  const Result<ManagerCore::PeerIdentifier> place = core_.addPeer(identity_);
  if (!place) return place.reason();
  place_ = *place;
  return std::nullopt;
}

void Peer::performCommand(const std::string& command, const ipc::Dictionary& request, const Answer& answer) {
  if (const std::optional<std::string> full = takePlace()) return answer(replyOf(CommandStatus::noPlace, *full));
  if (*pending_ >= pendingLimit) return answer(replyOf(CommandStatus::tooManyCommands, std::to_string(pendingLimit)));
  if (command == rhox::kCommandStatus) {
    const ipc::Object* times = request.find(rhox::kKeyEventTimes);
    if (times != nullptr && times->asBool() != nullptr) sendsTimes_ = *times->asBool();
  }
  ++*pending_;
  core_.performCommand(*place_, command, request, [answer, pending = pending_](const bus::Reply& reply) {
    --*pending;
    answer(reply);
  });
}

void Peer::setEvents(bool on) {
  if (!takePlace()) core_.setEvents(*place_, on);
}

std::size_t Peer::sendEvents(bus::EventOutlet& outlet, std::size_t limit) {
  if (!place_) return 0;
  std::size_t count = 0;
  for (; count < limit && outlet.ready(); ++count) {
    const std::optional<DeliveryQueue::Numbered> next = core_.take(*place_);
    if (!next) break;
    // An event that cannot be sent leaves a gap in the numbers; work() detects a closed connection.
    outlet.sendEvent(rhox::kEventMetric, next->sequence, toDictionary(next->event, sendsTimes_));
  }
  return count;
}

}  // namespace vespscope::manager
