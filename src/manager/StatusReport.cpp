#include "manager/StatusReport.h"

#include <chrono>
#include <cstdint>
#include <string>
#include <utility>

#include "manager/Commands.h"
#include "rhoxlink/bus/Playback.h"

namespace vespscope::manager {
namespace {

using ipc::Dictionary;
using ipc::Object;

Object count(std::uint64_t number) { return Object(static_cast<std::int64_t>(number)); }

Object secondsSince(Distribution::Clock::time_point begin) {
  const auto passed = std::chrono::duration_cast<std::chrono::seconds>(Distribution::Clock::now() - begin);
  return Object(std::int64_t{passed.count()});
}

Object describe(const ClientState& client) {
  Dictionary entry;
  if (!client.name.empty()) entry.set(rhox::kKeyClientName, Object(client.name));
  if (client.application) entry.set(rhox::kKeyAppID, Object(*client.application));
  entry.set(rhox::kKeyUser, Object(std::int64_t{client.identity.user}));
  if (client.identity.process != 0) entry.set(rhox::kKeyProcess, Object(client.identity.process));
  if (!client.identity.busName.empty()) entry.set(rhox::kKeyBusName, Object(client.identity.busName));
  entry.set(rhox::kKeySeconds, secondsSince(client.since));
  entry.set(rhox::kKeyListening, Object(client.listening));
  entry.set(rhox::kKeyEventsDelivered, count(client.delivered));
  entry.set(rhox::kKeyEventsLost, count(client.lost));
  entry.set(rhox::kKeyEventsQueued, count(client.queued));
  return Object(std::move(entry));
}

}  // namespace

bus::Reply StatusReport::make(Distribution::Peer peer, const Dictionary& request, const EventRecorder* recorder) const {
  const ClientState client = distribution_.stateOf(peer);
  bus::Reply reply = replyOf(CommandStatus::ok);
  reply.values.set(rhox::kKeyProtocol, Object(rhox::kProtocol));
  reply.values.set(rhox::kKeySourceLabel, Object(source_.label()));
  reply.values.set(rhox::kKeySourceKind, Object(std::string(wordOf(source_.kind()))));
  reply.values.set(rhox::kKeyConfigured,
                   Object(client.application.has_value() && book_.find(*client.application) != nullptr));
  reply.values.set(rhox::kKeyEventsLost, count(client.lost));
  if (const auto position = source_.playback()) reply.values.set(rhox::kKeyPlayback, bus::toObject(*position));
  if (const auto card = source_.simCard()) reply.values.set(rhox::kKeyProfileID, Object(std::int64_t{*card}));
  if (recorder != nullptr) {
    const RecordingStatus recording = recorder->status();
    reply.values.set(rhox::kKeyEventsRecorded, count(recording.recorded));
    reply.values.set(rhox::kKeyRecordingLost, count(recording.lost));
    if (!recording.problem.empty()) reply.values.set(rhox::kKeyRecordingProblem, Object(recording.problem));
  }
  if (const Object* details = request.find(rhox::kKeyDetails);
      details != nullptr && details->asBool() != nullptr && *details->asBool()) {
    addDetails(reply.values);
  }
  return reply;
}

void StatusReport::addDetails(Dictionary& values) const {
  values.set(rhox::kKeySeconds, secondsSince(started_));
  ipc::Array clients;
  for (const ClientState& client : distribution_.states()) clients.push_back(describe(client));
  values.set(rhox::kKeyClients, Object(std::move(clients)));
  ipc::Array configurations;
  for (const auto& [application, configuration] : book_.all()) {
    Dictionary entry;
    entry.set(rhox::kKeyAppID, Object(application));
    entry.set(rhox::kKeyMetrics, count(configuration->size()));
    configurations.push_back(Object(std::move(entry)));
  }
  values.set(rhox::kKeyConfigurations, Object(std::move(configurations)));
}

}  // namespace vespscope::manager
