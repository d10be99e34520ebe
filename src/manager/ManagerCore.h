// The manager's core: gives each command of its clients to the class that answers it, and the source's events to those
// that record and distribute them. Knows nothing of sockets.
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

// Belongs to one thread, but for deliver().
class ManagerCore final : public sources::EventSink {
 public:
  using Clock = Distribution::Clock;
  using PeerIdentifier = Distribution::Peer;
  using Answer = bus::Service::Answer;

  // `workWaits` is called, on any thread, when there is something to take(), to answer, or to collectDue() earlier than
  // before. With a `store`, the configurations it kept are active from the start.
  ManagerCore(std::unique_ptr<sources::Source> source, const std::function<void()>& workWaits,
              std::optional<ConfigurationStore> store = std::nullopt, DeliveryQueue::Bounds bounds = {});
  ManagerCore(const ManagerCore&) = delete;
  ManagerCore& operator=(const ManagerCore&) = delete;
  ~ManagerCore() override;

  // Records what the source delivers, all of it, and starts the source, whether or not a client listens. Once, before
  // there are clients.
  void recordTo(std::unique_ptr<EventRecorder> recorder);

  // Stops the source: it neither delivers anything nor calls `workWaits` any longer.
  void stop() { source_->stop(); }

  // Gives a client one of the manager's places; the reason when there is none for its user.
  [[nodiscard]] Result<PeerIdentifier> addPeer(const bus::ClientIdentity& identity);
  void removePeer(PeerIdentifier peer);

  // Calls `answer` at once, or from sendAnswers() when the command had to be written to the disk first.
  void performCommand(PeerIdentifier peer, const std::string& command, const ipc::Dictionary& request,
                      const Answer& answer);
  void setEvents(PeerIdentifier peer, bool on);
  void sendAnswers() { book_.sendAnswers(); }

  // From the source, which starts when the first client listens for a configured application, or with recording. Safe
  // from any thread.
  void deliver(MetricEvent event) override;

  // The next event to send to a client; none while it does not listen.
  [[nodiscard]] std::optional<DeliveryQueue::Numbered> take(PeerIdentifier peer) { return distribution_.take(peer); }
  // Queues the events whose period has ended and writes log lines that are due; returns when to call again.
  std::optional<Clock::time_point> collectDue(Clock::time_point now);

  // Where refused clients are logged.
  [[nodiscard]] LogRate& refusals() { return refusals_; }

 private:
  // The client listens for the request's application from now on; the refusal of a request that names none.
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
