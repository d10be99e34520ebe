#include "manager/SimCardFileQueries.h"

#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

#include "manager/Commands.h"
#include "registry/MetricRows.h"

namespace vespscope::manager {
namespace {

using bus::Reply;

constexpr std::int64_t simCardFilesTrigger = 0x7F0013;  // group 0x7F, tag 19
constexpr std::int32_t simCardFilesMetric = metricIdentifier("K_SIM_FILE_INFO");

}  // namespace

Reply SimCardFileQueries::perform(Distribution::Peer peer, std::int64_t application, const ipc::Dictionary& request) {
  for (const std::string_view key : {rhox::kKeyPayloadType, rhox::kKeyTriggerRef, rhox::kKeyTriggerType,
                                     rhox::kKeyTriggerID, rhox::kKeyProfileID, rhox::kKeyMetricID}) {
    if (integerIn(request, key) == nullptr) return lacks(key, "an integer");
  }
  if (const std::int64_t trigger = *integerIn(request, rhox::kKeyTriggerID); trigger != simCardFilesTrigger) {
    return replyOf(CommandStatus::unknownTrigger, std::to_string(trigger));
  }
  if (!distribution_.stateOf(peer).listening) return replyOf(CommandStatus::deliveryOff);
  if (!begin()) return replyOf(CommandStatus::tooManyQueries, std::to_string(limit));
  return find({peer, application, *integerIn(request, rhox::kKeyProfileID)});
}

bool SimCardFileQueries::begin() {
  const std::lock_guard lock(mutex_);
  if (waiting_ == limit) return false;
  ++waiting_;
  return true;
}

Reply SimCardFileQueries::find(const Query& query) {
  // The thread that takes this first decides whether the files are the reply or follow it as an event.
  struct Outcome {
    std::mutex mutex;
    bool accepted = false;
    std::optional<Reply> reply;
  };
  const auto outcome = std::make_shared<Outcome>();
  source_.findSimCardFiles([this, query, outcome](std::optional<MetricEvent> files) {
    Reply given = give(query, std::move(files));
    const std::lock_guard lock(outcome->mutex);
    if (outcome->accepted) {
      if (given.status != 0) failures_.write(given.message);
    } else {
      outcome->reply = std::move(given);
    }
  });
  const std::lock_guard lock(outcome->mutex);
  outcome->accepted = true;
  return outcome->reply.value_or(replyOf(CommandStatus::ok));
}

Reply SimCardFileQueries::give(const Query& query, std::optional<MetricEvent> files) {
  {
    const std::lock_guard lock(mutex_);
    --waiting_;
  }
  if (!files) return replyOf(CommandStatus::noSimCardFiles, source_.label());
  if (files->profileID != query.profile) {
    return replyOf(CommandStatus::noSimCardFiles, "profile " + std::to_string(query.profile));
  }
  files->metricID = simCardFilesMetric;
  // The client that asked may have disconnected meanwhile, or now listen for another application.
  distribution_.deliverTo(query.peer, query.application, std::make_shared<const MetricEvent>(std::move(*files)));
  return replyOf(CommandStatus::ok);
}

}  // namespace vespscope::manager
