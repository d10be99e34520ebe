#include "manager/ManagerCore.h"

#include <algorithm>
#include <string_view>
#include <utility>

#include "platform/log/Log.h"
#include "registry/MetricRows.h"
#include "rhoxlink/bus/Playback.h"

namespace vespscope::manager {
namespace {

using bus::Reply;
using ipc::Dictionary;
using ipc::Object;

constexpr std::int64_t simCardFilesTrigger = 0x7F0013;  // group 0x7F, tag 19
constexpr std::int32_t simCardFilesMetric = metricIdentifier("K_SIM_FILE_INFO");

constexpr std::size_t longestClientName = 256;  // bytes

// Applications with a configuration at a time: who may configure one shall not fill the memory, or the disk where
// configurations are kept.
constexpr std::size_t applicationLimit = 64;

// An event that waits may be found due this much too late, which spares a wake for each event that replaces it.
constexpr std::chrono::milliseconds dueTolerance{1};

Reply answer(CommandStatus status, std::string_view detail = {}) {
  return {static_cast<std::int32_t>(status), messageOf(status, detail), {}};
}

const std::int64_t* integerIn(const Dictionary& request, std::string_view key) {
  const Object* object = request.find(key);
  return object == nullptr ? nullptr : object->asInt64();
}

Reply lacks(std::string_view key, std::string_view kind) {
  return answer(CommandStatus::badRequest, std::string(key) + " must be " + std::string(kind));
}

std::string_view textOf(const Bytes& bytes) { return {reinterpret_cast<const char*>(bytes.data()), bytes.size()}; }

Object count(std::uint64_t number) { return Object(static_cast<std::int64_t>(number)); }

Object secondsSince(ManagerCore::Clock::time_point begin) {
  const auto passed = std::chrono::duration_cast<std::chrono::seconds>(ManagerCore::Clock::now() - begin);
  return Object(std::int64_t{passed.count()});
}

}  // namespace

ManagerCore::ManagerCore(std::unique_ptr<sources::Source> source, std::function<void()> eventsWait,
                         std::optional<ConfigurationStore> store, DeliveryQueue::Bounds bounds)
    : source_(std::move(source)), eventsWait_(std::move(eventsWait)), store_(std::move(store)), bounds_(bounds) {
  if (!store_) return;
  const ConfigurationStore::Kept kept = store_->load(applicationLimit);
  for (const std::string& problem : kept.problems) log::system(problem);
  for (const auto& [application, bytes] : kept.configurations) {
    const Result<Configuration> configuration = Configuration::parse(textOf(bytes));
    if (configuration) {
      configurations_[application] = std::make_shared<const Configuration>(*configuration);
      continue;
    }
    const Result<std::string> aside = store_->setAside(application);
    log::system("the configuration kept for application " + std::to_string(application) + " is not used: " +
                configuration.reason() + " (" + (aside ? "it is now " + *aside : aside.reason()) + ")");
  }
}

ManagerCore::~ManagerCore() { stop(); }

void ManagerCore::recordTo(std::unique_ptr<EventRecorder> recorder) {
  recorder_ = std::move(recorder);
  startSourceIfWanted();
}

ManagerCore::PeerIdentifier ManagerCore::addPeer(const bus::ClientIdentity& identity) {
  const std::lock_guard lock(mutex_);
  peers_.try_emplace(++lastPeer_, identity, bounds_);
  return lastPeer_;
}

std::size_t ManagerCore::peerCount() const {
  const std::lock_guard lock(mutex_);
  return peers_.size();
}

void ManagerCore::removePeer(PeerIdentifier peer) {
  const std::lock_guard lock(mutex_);
  peers_.erase(peer);
}

Reply ManagerCore::performCommand(PeerIdentifier identifier, const std::string& command, const Dictionary& request) {
  Reply reply;
  std::optional<SimCardQuery> query;
  {
    const std::lock_guard lock(mutex_);
    Peer& peer = peers_.at(identifier);
    if (command == rhox::kCommandAddConfiguration) {
      reply = addConfiguration(peer, request);
    } else if (command == rhox::kCommandClearConfiguration) {
      reply = clearConfiguration(peer, request);
    } else if (command == rhox::kCommandQueryMetric) {
      reply = checkQuery(peer, request);
      if (reply.status == 0) query = {identifier, *peer.application, *integerIn(request, rhox::kKeyProfileID)};
    } else if (command == rhox::kCommandStatus) {
      reply = tellStatus(peer, request);
    } else {
      reply = answer(CommandStatus::unknownCommand, command);
    }
  }
  startSourceIfWanted();
  // Outside the lock: it may take a while.
  return query ? findSimCardFiles(*query) : reply;
}

std::optional<Reply> ManagerCore::joinApplication(Peer& peer, const Dictionary& request) {
  const std::int64_t* application = integerIn(request, rhox::kKeyAppID);
  if (application == nullptr) return lacks(rhox::kKeyAppID, "an integer");
  if (peer.application != *application) {
    peer.application = *application;
    peer.filter = {};
    peer.filter.setConfiguration(configurationOf(peer));
    peer.queue.clear();
    offerLatest(peer);
  }
  return std::nullopt;
}

Reply ManagerCore::addConfiguration(Peer& peer, const Dictionary& request) {
  if (std::optional<Reply> refusal = joinApplication(peer, request)) return *refusal;
  const Object* payload = request.find(rhox::kKeyPayload);
  if (payload == nullptr || payload->asData() == nullptr) return lacks(rhox::kKeyPayload, "data");
  const std::int64_t* type = integerIn(request, rhox::kKeyPayloadType);
  if (type == nullptr || *type != 0) return lacks(rhox::kKeyPayloadType, "0");
  const Result<Configuration> configuration = Configuration::parse(textOf(*payload->asData()));
  if (!configuration) return answer(CommandStatus::badConfiguration, configuration.reason());
  if (configurations_.size() >= applicationLimit && !configurations_.contains(*peer.application)) {
    return answer(CommandStatus::tooManyApplications, std::to_string(applicationLimit));
  }
  configure(*peer.application, std::make_shared<const Configuration>(*configuration));
  if (store_) {
    if (const auto problem = store_->save(*peer.application, *payload->asData())) log::system(*problem);
  }
  return answer(CommandStatus::ok);
}

Reply ManagerCore::clearConfiguration(Peer& peer, const Dictionary& request) {
  if (std::optional<Reply> refusal = joinApplication(peer, request)) return *refusal;
  configure(*peer.application, nullptr);
  if (store_) store_->remove(*peer.application);
  return answer(CommandStatus::ok);
}

void ManagerCore::configure(std::int64_t application, const std::shared_ptr<const Configuration>& configuration) {
  if (configuration) {
    configurations_[application] = configuration;
  } else {
    configurations_.erase(application);
  }
  for (auto& [identifier, peer] : peers_) {
    if (peer.application != application) continue;
    peer.filter.setConfiguration(configuration);
    if (!configuration) peer.queue.clear();
    offerLatest(peer);
  }
}

Reply ManagerCore::checkQuery(Peer& peer, const Dictionary& request) {
  if (std::optional<Reply> refusal = joinApplication(peer, request)) return *refusal;
  for (const std::string_view key : {rhox::kKeyPayloadType, rhox::kKeyTriggerRef, rhox::kKeyTriggerType,
                                     rhox::kKeyTriggerID, rhox::kKeyProfileID, rhox::kKeyMetricID}) {
    if (integerIn(request, key) == nullptr) return lacks(key, "an integer");
  }
  if (const std::int64_t trigger = *integerIn(request, rhox::kKeyTriggerID); trigger != simCardFilesTrigger) {
    return answer(CommandStatus::unknownTrigger, std::to_string(trigger));
  }
  if (!peer.listening) return answer(CommandStatus::deliveryOff);
  if (queriesWaiting_ == queryLimit) return answer(CommandStatus::tooManyQueries, std::to_string(queryLimit));
  ++queriesWaiting_;
  return answer(CommandStatus::ok);
}

Reply ManagerCore::findSimCardFiles(const SimCardQuery& query) {
  // Whoever takes it first decides whether what was found is the reply or comes after it.
  struct Outcome {
    std::mutex mutex;
    bool accepted = false;
    std::optional<Reply> reply;
  };
  const auto outcome = std::make_shared<Outcome>();
  source_->findSimCardFiles([this, query, outcome](std::optional<MetricEvent> files) {
    Reply given = giveSimCardFiles(query, std::move(files));
    const std::lock_guard lock(outcome->mutex);
    if (outcome->accepted) {
      if (given.status != 0) log::system(given.message);
    } else {
      outcome->reply = std::move(given);
    }
  });
  const std::lock_guard lock(outcome->mutex);
  outcome->accepted = true;
  return outcome->reply.value_or(answer(CommandStatus::ok));
}

Reply ManagerCore::giveSimCardFiles(const SimCardQuery& query, std::optional<MetricEvent> files) {
  const std::lock_guard lock(mutex_);
  --queriesWaiting_;
  if (!files) return answer(CommandStatus::noSimCardFiles, source_->label());
  if (files->profileID != query.profile) {
    return answer(CommandStatus::noSimCardFiles, "profile " + std::to_string(query.profile));
  }
  files->metricID = simCardFilesMetric;
  // Who asked may have gone meanwhile, or now be another application's.
  if (const auto found = peers_.find(query.peer);
      found != peers_.end() && found->second.application == query.application) {
    queue(found->second, {std::make_shared<const MetricEvent>(std::move(*files))});
  }
  return answer(CommandStatus::ok);
}

Reply ManagerCore::tellStatus(Peer& peer, const Dictionary& request) {
  if (request.find(rhox::kKeyAppID) != nullptr) {
    if (std::optional<Reply> refusal = joinApplication(peer, request)) return *refusal;
  }
  if (const Object* name = request.find(rhox::kKeyClientName); name != nullptr && name->asString() != nullptr) {
    peer.clientName = name->asString()->substr(0, longestClientName);
  }
  Reply reply = answer(CommandStatus::ok);
  reply.values.set(rhox::kKeyProtocol, Object(rhox::kProtocol));
  reply.values.set(rhox::kKeySourceLabel, Object(source_->label()));
  reply.values.set(rhox::kKeySourceKind, Object(std::string(wordOf(source_->kind()))));
  reply.values.set(rhox::kKeyConfigured, Object(configurationOf(peer) != nullptr));
  reply.values.set(rhox::kKeyEventsLost, count(peer.queue.lost()));
  if (const auto position = source_->playback()) reply.values.set(rhox::kKeyPlayback, bus::toObject(*position));
  if (recorder_) {
    const RecordingStatus recording = recorder_->status();
    reply.values.set(rhox::kKeyEventsRecorded, count(recording.recorded));
    reply.values.set(rhox::kKeyRecordingLost, count(recording.lost));
    if (!recording.problem.empty()) reply.values.set(rhox::kKeyRecordingProblem, Object(recording.problem));
  }
  if (const Object* details = request.find(rhox::kKeyDetails);
      details != nullptr && details->asBool() != nullptr && *details->asBool()) {
    tellDetails(reply.values);
  }
  return reply;
}

void ManagerCore::tellDetails(Dictionary& values) const {
  values.set(rhox::kKeySeconds, secondsSince(started_));
  ipc::Array clients;
  for (const auto& [identifier, peer] : peers_) clients.push_back(describe(peer));
  values.set(rhox::kKeyClients, Object(std::move(clients)));
  ipc::Array configurations;
  for (const auto& [application, configuration] : configurations_) {
    Dictionary entry;
    entry.set(rhox::kKeyAppID, Object(application));
    entry.set(rhox::kKeyMetrics, count(configuration->size()));
    configurations.push_back(Object(std::move(entry)));
  }
  values.set(rhox::kKeyConfigurations, Object(std::move(configurations)));
}

Object ManagerCore::describe(const Peer& peer) {
  Dictionary entry;
  if (!peer.clientName.empty()) entry.set(rhox::kKeyClientName, Object(peer.clientName));
  if (peer.application) entry.set(rhox::kKeyAppID, Object(*peer.application));
  entry.set(rhox::kKeyUser, Object(std::int64_t{peer.identity.user}));
  if (peer.identity.process != 0) entry.set(rhox::kKeyProcess, Object(peer.identity.process));
  if (!peer.identity.busName.empty()) entry.set(rhox::kKeyBusName, Object(peer.identity.busName));
  entry.set(rhox::kKeySeconds, secondsSince(peer.since));
  entry.set(rhox::kKeyListening, Object(peer.listening));
  entry.set(rhox::kKeyEventsDelivered, count(peer.delivered));
  entry.set(rhox::kKeyEventsLost, count(peer.queue.lost()));
  entry.set(rhox::kKeyEventsQueued, count(peer.queue.size()));
  return Object(std::move(entry));
}

void ManagerCore::setEvents(PeerIdentifier identifier, bool on) {
  {
    const std::lock_guard lock(mutex_);
    Peer& peer = peers_.at(identifier);
    peer.listening = on;
    if (on) {
      offerLatest(peer);
      eventsWait_();  // for what was queued when delivery was turned off
    }
  }
  startSourceIfWanted();
}

void ManagerCore::deliver(MetricEvent event) {
  const auto shared = std::make_shared<const MetricEvent>(std::move(event));
  if (recorder_) recorder_->record(shared);
  const Clock::time_point now = Clock::now();
  const std::lock_guard lock(mutex_);
  if (const std::pair key{shared->metricID, shared->profileID};
      latest_.size() < DeliveryFilter::slotLimit || latest_.contains(key)) {
    latest_[key] = shared;
  }
  std::vector<SharedEvent> due;
  for (auto& [identifier, peer] : peers_) {
    if (!peer.listening) continue;
    due.clear();
    const auto before = peer.filter.nextDue();
    peer.filter.offer(shared, now, due);
    queue(peer, due);
    const auto after = peer.filter.nextDue();
    if (after && (!before || *after + dueTolerance < *before)) eventsWait_();
  }
}

// A client that joins sees the current values at once; those it has seen are not repeated.
void ManagerCore::offerLatest(Peer& peer) {
  if (!peer.listening) return;
  std::vector<SharedEvent> events;
  events.reserve(latest_.size());
  for (const auto& [key, event] : latest_) events.push_back(event);
  std::sort(events.begin(), events.end(),
            [](const SharedEvent& one, const SharedEvent& other) { return one->time < other->time; });
  std::vector<SharedEvent> due;
  for (const SharedEvent& event : events) peer.filter.offer(event, Clock::now(), due);
  queue(peer, due);
}

void ManagerCore::queue(Peer& peer, const std::vector<SharedEvent>& due) {
  if (due.empty()) return;
  const bool wasEmpty = peer.queue.empty();
  for (const SharedEvent& event : due) peer.queue.push(event);
  if (wasEmpty) eventsWait_();
}

std::shared_ptr<const Configuration> ManagerCore::configurationOf(const Peer& peer) const {
  if (!peer.application) return nullptr;
  const auto found = configurations_.find(*peer.application);
  return found == configurations_.end() ? nullptr : found->second;
}

std::optional<DeliveryQueue::Numbered> ManagerCore::take(PeerIdentifier peer) {
  const std::lock_guard lock(mutex_);
  Peer& known = peers_.at(peer);
  if (!known.listening) return std::nullopt;
  std::optional<DeliveryQueue::Numbered> next = known.queue.take();
  if (next) ++known.delivered;
  return next;
}

std::optional<ManagerCore::Clock::time_point> ManagerCore::collectDue(Clock::time_point now) {
  const std::lock_guard lock(mutex_);
  std::optional<Clock::time_point> next;
  std::vector<SharedEvent> due;
  for (auto& [identifier, peer] : peers_) {
    if (!peer.listening) continue;
    due.clear();
    peer.filter.collect(now, due);
    queue(peer, due);
    const std::optional<Clock::time_point> coming = peer.filter.nextDue();
    if (coming && (!next || *coming < *next)) next = coming;
  }
  return next;
}

bool ManagerCore::sourceWanted() const {
  return recorder_ != nullptr || std::any_of(peers_.begin(), peers_.end(), [this](const auto& entry) {
           return entry.second.listening && configurationOf(entry.second) != nullptr;
         });
}

// Outside the lock: a source may deliver its first event before start() returns.
void ManagerCore::startSourceIfWanted() {
  {
    const std::lock_guard lock(mutex_);
    if (sourceStarted_ || !sourceWanted()) return;
    sourceStarted_ = true;
  }
  source_->start(*this);
}

}  // namespace vespscope::manager
