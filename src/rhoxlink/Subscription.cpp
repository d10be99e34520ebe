#include "rhoxlink/Subscription.h"

#include "rhoxlink/bus/Names.h"

namespace rhox::client {
namespace {

using vespscope::bus::Reply;
using vespscope::ipc::Dictionary;
using vespscope::ipc::Object;

std::optional<std::int64_t> applicationIn(const Dictionary& request) {
  const Object* application = request.find(kKeyAppID);
  if (application == nullptr || application->asInt64() == nullptr) return std::nullopt;
  return *application->asInt64();
}

std::string refusal(const Reply& reply) {
  return (reply.status == kStatusNotConnected ? "the configuration was not sent: "
                                              : "the manager refused the configuration: ") +
         reply.message;
}

}  // namespace

void Subscription::sending(const Dictionary& request) {
  if (const auto application = applicationIn(request)) application_ = application;
}

void Subscription::answered(std::string_view command, const Dictionary& request, const Reply& reply) {
  const std::optional<std::int64_t> application = applicationIn(request);
  if (!application) return;
  if (command == kCommandAddConfiguration) {
    if (reply.status == 0) {
      accepted_.insert_or_assign(*application, request);
      problem_.clear();
    } else if (!accepted_.contains(*application)) {
      problem_ = refusal(reply);
    }
  } else if (command == kCommandClearConfiguration && reply.status == 0) {
    accepted_.erase(*application);
    problem_ = "the configuration was cleared";
  }
}

std::vector<Dictionary> Subscription::begin() {
  std::vector<Dictionary> requests;
  requests.reserve(accepted_.size());
  for (const auto& [application, request] : accepted_) requests.push_back(request);
  unanswered_ = requests.size();
  if (!requests.empty()) problem_.clear();
  return requests;
}

void Subscription::givenAgain(const Reply& reply) {
  if (reply.status == kStatusConnectionLost) return;  // the next connection sends them again
  --unanswered_;
  if (reply.status != 0) problem_ = refusal(reply);
}

void Subscription::reported(bool configured) {
  if (unanswered_ != 0) return;  // the answers are more recent
  if (configured) {
    problem_.clear();
  } else if (problem_.empty()) {
    problem_ = "the manager has no configuration for this application";
  }
}

}  // namespace rhox::client
