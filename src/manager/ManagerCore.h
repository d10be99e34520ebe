// The manager's heart: the commands of its clients, their applications' configurations, and what of the source's
// events each client is due. Knows nothing of sockets.
#pragma once

#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "manager/CommandStatus.h"
#include "manager/Configuration.h"
#include "manager/ConfigurationStore.h"
#include "manager/DeliveryFilter.h"
#include "manager/DeliveryQueue.h"
#include "manager/EventRecorder.h"
#include "rhoxlink/bus/Bus.h"
#include "sources/playback/Source.h"

namespace vespscope::manager {

// Safe from any thread.
class ManagerCore final : public sources::EventSink {
 public:
  using Clock = DeliveryFilter::Clock;
  using PeerIdentifier = std::uint64_t;

  // `eventsWait` is called, on any thread, when a client's queue is no longer empty or its next due time changed.
  // With a `store`, the configurations it kept are active from the start.
  ManagerCore(std::unique_ptr<sources::Source> source, std::function<void()> eventsWait,
              std::optional<ConfigurationStore> store = std::nullopt, DeliveryQueue::Bounds bounds = {});
  ManagerCore(const ManagerCore&) = delete;
  ManagerCore& operator=(const ManagerCore&) = delete;
  ~ManagerCore() override;

  // Records what the source delivers, all of it, and starts the source, whether or not somebody listens. Once, before
  // there are clients.
  void recordTo(std::unique_ptr<EventRecorder> recorder);

  // Stops the source: nothing is delivered and `eventsWait` no longer called by it.
  void stop() { source_->stop(); }

  static constexpr std::size_t peerLimit = 32;  // clients; keeping it is for those who add them
  PeerIdentifier addPeer(const bus::ClientIdentity& identity = {});
  void removePeer(PeerIdentifier peer);
  [[nodiscard]] std::size_t peerCount() const;

  bus::Reply performCommand(PeerIdentifier peer, const std::string& command, const ipc::Dictionary& request);
  void setEvents(PeerIdentifier peer, bool on);

  // From the source, which starts when the first client listens for a configured application, or with recording.
  void deliver(MetricEvent event) override;

  // The next event to send to a client; none while it does not listen.
  [[nodiscard]] std::optional<DeliveryQueue::Numbered> take(PeerIdentifier peer);
  // Queues the events whose period has ended; the time at which to call again.
  std::optional<Clock::time_point> collectDue(Clock::time_point now);

 private:
  struct Peer {
    Peer(const bus::ClientIdentity& who, DeliveryQueue::Bounds bounds) : identity(who), queue(bounds) {}
    const bus::ClientIdentity identity;
    const Clock::time_point since = Clock::now();
    std::optional<std::int64_t> application;
    std::string clientName;
    bool listening = false;
    DeliveryFilter filter;
    DeliveryQueue queue;
    std::uint64_t delivered = 0;  // events taken from the queue
  };

  bus::Reply addConfiguration(Peer& peer, const ipc::Dictionary& request);
  bus::Reply clearConfiguration(Peer& peer, const ipc::Dictionary& request);
  // A query that is in order: who asked, and for what.
  struct SimCardQuery {
    PeerIdentifier peer = 0;
    std::int64_t application = 0;
    std::int64_t profile = 0;
  };
  static constexpr std::size_t queryLimit = 64;  // that wait for a search
  bus::Reply checkQuery(Peer& peer, const ipc::Dictionary& request);
  // Has the source look for the files. What it finds at once is told in the reply; else the query is accepted, and the
  // event follows when it is found.
  bus::Reply findSimCardFiles(const SimCardQuery& query);
  // Queues the files that were found for who asked, or says why not.
  bus::Reply giveSimCardFiles(const SimCardQuery& query, std::optional<MetricEvent> files);
  bus::Reply tellStatus(Peer& peer, const ipc::Dictionary& request);
  void tellDetails(ipc::Dictionary& values) const;
  [[nodiscard]] static ipc::Object describe(const Peer& peer);
  std::optional<bus::Reply> joinApplication(Peer& peer, const ipc::Dictionary& request);
  void configure(std::int64_t application, const std::shared_ptr<const Configuration>& configuration);
  [[nodiscard]] std::shared_ptr<const Configuration> configurationOf(const Peer& peer) const;
  void offerLatest(Peer& peer);
  void queue(Peer& peer, const std::vector<SharedEvent>& due);
  [[nodiscard]] bool sourceWanted() const;
  void startSourceIfWanted();

  const std::unique_ptr<sources::Source> source_;
  const std::function<void()> eventsWait_;
  const std::optional<ConfigurationStore> store_;
  std::unique_ptr<EventRecorder> recorder_;  // null: nothing is recorded
  const DeliveryQueue::Bounds bounds_;

  const Clock::time_point started_ = Clock::now();
  mutable std::mutex mutex_;
  std::map<PeerIdentifier, Peer> peers_;
  PeerIdentifier lastPeer_ = 0;
  std::map<std::int64_t, std::shared_ptr<const Configuration>> configurations_;  // by application number
  std::map<std::pair<std::int32_t, std::int32_t>, SharedEvent> latest_;          // by metric and profile
  std::size_t queriesWaiting_ = 0;
  bool sourceStarted_ = false;
};

}  // namespace vespscope::manager
