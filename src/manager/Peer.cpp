#include "manager/Peer.h"

#include <optional>

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

void Peer::performCommand(const std::string& command, const ipc::Dictionary& request, const Answer& answer) {
  if (command == rhox::kCommandStatus) {
    const ipc::Object* times = request.find(rhox::kKeyEventTimes);
    if (times != nullptr && times->asBool() != nullptr) sendsTimes_ = *times->asBool();
  }
  answer(core_.performCommand(identifier_, command, request));
}

std::size_t Peer::sendEvents(bus::EventOutlet& outlet, std::size_t limit) {
  std::size_t count = 0;
  for (; count < limit && outlet.ready(); ++count) {
    const std::optional<DeliveryQueue::Numbered> next = core_.take(identifier_);
    if (!next) break;
    // What cannot be sent leaves its number out; a connection that is over shows when it works.
    outlet.sendEvent(rhox::kEventMetric, next->sequence, toDictionary(next->event, sendsTimes_));
  }
  return count;
}

}  // namespace vespscope::manager
