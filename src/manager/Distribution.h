// Delivers the source's events to the clients: a filter and a bounded queue for every client, and the last value of
// each metric for clients that join later.
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <map>
#include <mutex>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "manager/DeliveryFilter.h"
#include "manager/DeliveryQueue.h"
#include "rhoxlink/bus/Bus.h"

namespace vespscope::manager {

// The facts about a client.
struct ClientState {
  bus::ClientIdentity identity;
  DeliveryFilter::Clock::time_point since;  // time of connecting
  std::string name;                         // as the client named itself
  std::optional<std::int64_t> application;  // the application it listens for
  bool listening = false;                   // delivery is on
  std::uint64_t delivered = 0;              // events taken from its queue
  std::uint64_t lost = 0;                   // events that its queue dropped
  std::size_t queued = 0;                   // waiting events
};

// Safe from any thread.
class Distribution {
 public:
  using Clock = DeliveryFilter::Clock;
  using Peer = std::uint64_t;
  using Active = std::shared_ptr<const Configuration>;

  // `eventsWait` is called, on any thread, when a client's queue is no longer empty or its next due time changed.
  Distribution(std::function<void()> eventsWait, DeliveryQueue::Bounds bounds)
      : eventsWait_(std::move(eventsWait)), bounds_(bounds) {}

  Peer add(const bus::ClientIdentity& identity);
  void remove(Peer peer);
  [[nodiscard]] ClientState stateOf(Peer peer) const;
  [[nodiscard]] std::vector<ClientState> states() const;
  // Whether a client listens for an application that has a configuration.
  [[nodiscard]] bool isWanted() const;

  void setName(Peer peer, std::string name);
  // From now on the client listens for `application`, which has this configuration; without effect when it does
  // already.
  void join(Peer peer, std::int64_t application, const Active& configuration);
  void setListening(Peer peer, bool on);
  // Gives all clients of the application a new configuration, or none.
  void configure(std::int64_t application, const Active& configuration);

  // Queues the event for each client to which it is due.
  void deliver(const SharedEvent& event);
  // Queues the event for one client if it is still connected and listens for `application`.
  void deliverTo(Peer peer, std::int64_t application, SharedEvent event);

  // The next event to send to a client; none unless it listens.
  [[nodiscard]] std::optional<DeliveryQueue::Numbered> take(Peer peer);
  // Queues the events whose period has ended; returns when to call again.
  std::optional<Clock::time_point> collectDue(Clock::time_point now);

 private:
  struct Client {
    Client(const bus::ClientIdentity& identity, DeliveryQueue::Bounds bounds) : queue(bounds) {
      state.identity = identity;
      state.since = Clock::now();
    }
    [[nodiscard]] ClientState current() const;

    ClientState state;  // without the facts that the queue has
    bool configured = false;
    DeliveryFilter filter;
    DeliveryQueue queue;
  };

  void configure(Client& client, const Active& configuration);
  void offerLatest(Client& client);
  void queue(Client& client, const std::vector<SharedEvent>& due);

  const std::function<void()> eventsWait_;
  const DeliveryQueue::Bounds bounds_;
  mutable std::mutex mutex_;
  std::map<Peer, Client> clients_;
  Peer last_ = 0;
  std::map<std::pair<std::int32_t, std::int32_t>, SharedEvent> latest_;  // by metric and profile
};

}  // namespace vespscope::manager
