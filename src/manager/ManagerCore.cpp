#include "manager/ManagerCore.h"

#include <unistd.h>

#include <algorithm>
#include <utility>

#include "manager/Commands.h"

namespace vespscope::manager {
namespace {

using bus::Reply;
using ipc::Dictionary;
using ipc::Object;

constexpr std::size_t longestClientName = 256;  // bytes

}  // namespace

ManagerCore::ManagerCore(std::unique_ptr<sources::Source> source, const std::function<void()>& workWaits,
                         std::optional<ConfigurationStore> store, DeliveryQueue::Bounds bounds)
    : source_(std::move(source)),
      places_(::geteuid()),
      book_(std::move(store), workWaits),
      distribution_(workWaits, bounds),
      queries_(*source_, distribution_),
      status_(*source_, book_, distribution_) {}

ManagerCore::~ManagerCore() { stop(); }

void ManagerCore::recordTo(std::unique_ptr<EventRecorder> recorder) {
  recorder_ = std::move(recorder);
  startSourceIfWanted();
}

Result<ManagerCore::PeerIdentifier> ManagerCore::addPeer(const bus::ClientIdentity& identity) {
  if (const std::optional<std::string> full = places_.take(identity.user)) {
    refusals_.write("refused a client of user " + std::to_string(identity.user) + ": " + *full);
    return Failure{*full};
  }
  return distribution_.add(identity);
}

void ManagerCore::removePeer(PeerIdentifier peer) {
  places_.leave(distribution_.stateOf(peer).identity.user);
  distribution_.remove(peer);
}

void ManagerCore::performCommand(PeerIdentifier peer, const std::string& command, const Dictionary& request,
                                 const Answer& answer) {
  if (command == rhox::kCommandAddConfiguration) {
    addConfiguration(peer, request, answer);
  } else if (command == rhox::kCommandClearConfiguration) {
    clearConfiguration(peer, request, answer);
  } else if (command == rhox::kCommandQueryMetric) {
    answer(queryMetric(peer, request));
  } else if (command == rhox::kCommandStatus) {
    answer(reportStatus(peer, request));
  } else {
    answer(replyOf(CommandStatus::unknownCommand, command.substr(0, longestClientName)));
  }
}

std::optional<Reply> ManagerCore::joinApplication(PeerIdentifier peer, const Dictionary& request) {
  const std::int64_t* application = integerIn(request, rhox::kKeyAppID);
  if (application == nullptr) return lacks(rhox::kKeyAppID, "an integer");
  distribution_.join(peer, *application, book_.find(*application));
  startSourceIfWanted();
  return std::nullopt;
}

void ManagerCore::addConfiguration(PeerIdentifier peer, const Dictionary& request, const Answer& answer) {
  if (const std::optional<Reply> refusal = joinApplication(peer, request)) return answer(*refusal);
  const Object* payload = request.find(rhox::kKeyPayload);
  if (payload == nullptr || payload->asData() == nullptr) return answer(lacks(rhox::kKeyPayload, "data"));
  const std::int64_t* type = integerIn(request, rhox::kKeyPayloadType);
  if (type == nullptr || *type != 0) return answer(lacks(rhox::kKeyPayloadType, "0"));
  const std::int64_t application = *integerIn(request, rhox::kKeyAppID);
  // Starts the source before the client has its answer.
  const auto activated = [this, application](const ConfigurationBook::Active& active) {
    distribution_.configure(application, active);
    startSourceIfWanted();
  };
  book_.add(application, *payload->asData(), activated, answer);
}

void ManagerCore::clearConfiguration(PeerIdentifier peer, const Dictionary& request, const Answer& answer) {
  if (const std::optional<Reply> refusal = joinApplication(peer, request)) return answer(*refusal);
  const std::int64_t application = *integerIn(request, rhox::kKeyAppID);
  distribution_.configure(application, nullptr);
  book_.clear(application, answer);
}

Reply ManagerCore::queryMetric(PeerIdentifier peer, const Dictionary& request) {
  if (std::optional<Reply> refusal = joinApplication(peer, request)) return *refusal;
  return queries_.perform(peer, *integerIn(request, rhox::kKeyAppID), request);
}

Reply ManagerCore::reportStatus(PeerIdentifier peer, const Dictionary& request) {
  if (request.find(rhox::kKeyAppID) != nullptr) {
    if (std::optional<Reply> refusal = joinApplication(peer, request)) return *refusal;
  }
  if (const Object* name = request.find(rhox::kKeyClientName); name != nullptr && name->asString() != nullptr) {
    distribution_.setName(peer, name->asString()->substr(0, longestClientName));
  }
  return status_.make(peer, request, recorder_.get());
}

void ManagerCore::setEvents(PeerIdentifier peer, bool on) {
  distribution_.setListening(peer, on);
  startSourceIfWanted();
}

void ManagerCore::deliver(MetricEvent event) {
  const auto shared = std::make_shared<const MetricEvent>(std::move(event));
  if (recorder_) recorder_->record(shared);
  distribution_.deliver(shared);
}

std::optional<ManagerCore::Clock::time_point> ManagerCore::collectDue(Clock::time_point now) {
  std::optional<Clock::time_point> next = distribution_.collectDue(now);
  for (const auto& due : {refusals_.report(now), book_.report(now), queries_.report(now)}) {
    if (due && (!next || *due < *next)) next = due;
  }
  return next;
}

void ManagerCore::startSourceIfWanted() {
  if (sourceStarted_ || (recorder_ == nullptr && !distribution_.isWanted())) return;
  sourceStarted_ = true;
  source_->start(*this);
}

}  // namespace vespscope::manager
