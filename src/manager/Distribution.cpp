#include "manager/Distribution.h"

#include <algorithm>

namespace vespscope::manager {
namespace {

// A waiting event may be delivered this much too late, which saves a wake for each event that replaces it.
constexpr std::chrono::milliseconds dueTolerance{1};

}  // namespace

ClientState Distribution::Client::current() const {
  ClientState now = state;
  now.lost = queue.lost();
  now.queued = queue.size();
  return now;
}

Distribution::Peer Distribution::add(const bus::ClientIdentity& identity) {
  const std::lock_guard lock(mutex_);
  clients_.try_emplace(++last_, identity, bounds_);
  return last_;
}

void Distribution::remove(Peer peer) {
  const std::lock_guard lock(mutex_);
  clients_.erase(peer);
}

ClientState Distribution::stateOf(Peer peer) const {
  const std::lock_guard lock(mutex_);
  return clients_.at(peer).current();
}

std::vector<ClientState> Distribution::states() const {
  const std::lock_guard lock(mutex_);
  std::vector<ClientState> states;
  states.reserve(clients_.size());
  for (const auto& [peer, client] : clients_) states.push_back(client.current());
  return states;
}

bool Distribution::isWanted() const {
  const std::lock_guard lock(mutex_);
  return std::any_of(clients_.begin(), clients_.end(),
                     [](const auto& entry) { return entry.second.state.listening && entry.second.configured; });
}

void Distribution::setName(Peer peer, std::string name) {
  const std::lock_guard lock(mutex_);
  clients_.at(peer).state.name = std::move(name);
}

void Distribution::join(Peer peer, std::int64_t application, const Active& configuration) {
  const std::lock_guard lock(mutex_);
  Client& client = clients_.at(peer);
  if (client.state.application == application) return;
  client.state.application = application;
  client.filter = {};
  client.queue.clear();
  configure(client, configuration);
}

void Distribution::setListening(Peer peer, bool on) {
  const std::lock_guard lock(mutex_);
  Client& client = clients_.at(peer);
  client.state.listening = on;
  if (!on) return;
  offerLatest(client);
  eventsWait_();  // for events queued before delivery was turned off
}

void Distribution::configure(std::int64_t application, const Active& configuration) {
  const std::lock_guard lock(mutex_);
  for (auto& [peer, client] : clients_) {
    if (client.state.application == application) configure(client, configuration);
  }
}

void Distribution::configure(Client& client, const Active& configuration) {
  client.configured = configuration != nullptr;
  client.filter.setConfiguration(configuration);
  if (!configuration) client.queue.clear();
  offerLatest(client);
}

void Distribution::deliver(const SharedEvent& event) {
  const Clock::time_point now = Clock::now();
  const std::lock_guard lock(mutex_);
  if (const std::pair key{event->metricID, event->profileID};
      latest_.size() < DeliveryFilter::slotLimit || latest_.contains(key)) {
    latest_[key] = event;
  }
  std::vector<SharedEvent> due;
  for (auto& [peer, client] : clients_) {
    if (!client.state.listening) continue;
    due.clear();
    const auto before = client.filter.nextDue();
    client.filter.offer(event, now, due);
    queue(client, due);
    const auto after = client.filter.nextDue();
    if (after && (!before || *after + dueTolerance < *before)) eventsWait_();
  }
}

void Distribution::deliverTo(Peer peer, std::int64_t application, SharedEvent event) {
  const std::lock_guard lock(mutex_);
  if (const auto found = clients_.find(peer);
      found != clients_.end() && found->second.state.application == application) {
    queue(found->second, {std::move(event)});
  }
}

// A client that joins receives the current values at once, except those it has received already.
void Distribution::offerLatest(Client& client) {
  if (!client.state.listening) return;
  std::vector<SharedEvent> events;
  events.reserve(latest_.size());
  for (const auto& [key, event] : latest_) events.push_back(event);
  std::sort(events.begin(), events.end(),
            [](const SharedEvent& one, const SharedEvent& other) { return one->time < other->time; });
  std::vector<SharedEvent> due;
  for (const SharedEvent& event : events) client.filter.offer(event, Clock::now(), due);
  queue(client, due);
}

void Distribution::queue(Client& client, const std::vector<SharedEvent>& due) {
  if (due.empty()) return;
  const bool wasEmpty = client.queue.empty();
  for (const SharedEvent& event : due) client.queue.push(event);
  if (wasEmpty) eventsWait_();
}

std::optional<DeliveryQueue::Numbered> Distribution::take(Peer peer) {
  const std::lock_guard lock(mutex_);
  Client& client = clients_.at(peer);
  if (!client.state.listening) return std::nullopt;
  std::optional<DeliveryQueue::Numbered> next = client.queue.take();
  if (next) ++client.state.delivered;
  return next;
}

std::optional<Distribution::Clock::time_point> Distribution::collectDue(Clock::time_point now) {
  const std::lock_guard lock(mutex_);
  std::optional<Clock::time_point> next;
  std::vector<SharedEvent> due;
  for (auto& [peer, client] : clients_) {
    if (!client.state.listening) continue;
    due.clear();
    client.filter.collect(now, due);
    queue(client, due);
    const std::optional<Clock::time_point> coming = client.filter.nextDue();
    if (coming && (!next || *coming < *next)) next = coming;
  }
  return next;
}

}  // namespace vespscope::manager
