// The manager's core: passes each command to the class that answers it, and the source's events to the classes that
// record and distribute them. Independent of sockets.
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "manager/ConfigurationBook.h"
#include "manager/ConfigurationStore.h"
#include "manager/Distribution.h"
#include "manager/EventRecorder.h"
#include "manager/LogRate.h"
#include "manager/Places.h"
#include "manager/SimCardFileQueries.h"
#include "manager/StatusReport.h"
#include "rhoxlink/bus/Bus.h"
#include "sources/playback/Source.h"

namespace vespscope::manager {

// Used by one thread only, except deliver().
class ManagerCore final : public sources::EventSink {
 public:
  using Clock = Distribution::Clock;
  using PeerIdentifier = Distribution::Peer;
  using Answer = bus::Service::Answer;

  // `workWaits` is called, on any thread, when there is something to take(), to answer, or to collectDue() earlier than
  // before. The configurations in `store` are active from the start.
  ManagerCore(std::unique_ptr<sources::Source> source, const std::function<void()>& workWaits,
              std::optional<ConfigurationStore> store = std::nullopt, DeliveryQueue::Bounds bounds = {});
  ManagerCore(const ManagerCore&) = delete;
  ManagerCore& operator=(const ManagerCore&) = delete;
  ~ManagerCore() override;

  // Records everything that the source delivers and starts the source, whether or not a client listens. Called once,
  // before clients are added.
  void recordTo(std::unique_ptr<EventRecorder> recorder);

  // Stops the source: afterwards it does not deliver events or call `workWaits`.
  void stop() { source_->stop(); }

  // Gives a client one of the manager's places; fails if none is free for its user.
  [[nodiscard]] Result<PeerIdentifier> addPeer(const bus::ClientIdentity& identity);
  void removePeer(PeerIdentifier peer);

  // Calls `answer` at once, or from sendAnswers() if the command must be written to the disk first.
  void performCommand(PeerIdentifier peer, const std::string& command, const ipc::Dictionary& request,
                      const Answer& answer);
  void setEvents(PeerIdentifier peer, bool on);
  void sendAnswers() { book_.sendAnswers(); }

  // Called by the source, which starts when the first client listens for a configured application, or with recording.
  // Safe from any thread.
  void deliver(MetricEvent event) override;

  // The next event to send to a client; none unless it listens.
  [[nodiscard]] std::optional<DeliveryQueue::Numbered> take(PeerIdentifier peer) { return distribution_.take(peer); }
  // Queues the events whose period has ended and writes pending log lines; returns when to call again.
  std::optional<Clock::time_point> collectDue(Clock::time_point now);

  // The log of rejected clients.
  [[nodiscard]] LogRate& refusals() { return refusals_; }

 private:
  // Makes the client listen for the request's application; returns the error reply if the request names none.
  std::optional<bus::Reply> joinApplication(PeerIdentifier peer, const ipc::Dictionary& request);
  void addConfiguration(PeerIdentifier peer, const ipc::Dictionary& request, const Answer& answer);
  void clearConfiguration(PeerIdentifier peer, const ipc::Dictionary& request, const Answer& answer);
  bus::Reply queryMetric(PeerIdentifier peer, const ipc::Dictionary& request);
  bus::Reply reportStatus(PeerIdentifier peer, const ipc::Dictionary& request);
  void startSourceIfWanted();

  const std::unique_ptr<sources::Source> source_;
  std::unique_ptr<EventRecorder> recorder_;  // null: nothing is recorded
  LogRate refusals_{"refused clients"};
  Places places_;
  ConfigurationBook book_;
  Distribution distribution_;
  SimCardFileQueries queries_;
  const StatusReport status_;
  bool sourceStarted_ = false;
};

}  // namespace vespscope::manager
