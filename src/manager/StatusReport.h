// The reply to a client that asks for the manager's status: its source, its recording, and on request its clients and
// configurations.
#pragma once

#include "manager/ConfigurationBook.h"
#include "manager/Distribution.h"
#include "manager/EventRecorder.h"
#include "sources/playback/Source.h"

namespace vespscope::manager {

class StatusReport {
 public:
  // All outlive it; the manager runs from now on.
  StatusReport(const sources::Source& source, const ConfigurationBook& book, const Distribution& distribution)
      : source_(source), book_(book), distribution_(distribution) {}

  // For the client `peer`; `recorder` is null when nothing is recorded.
  [[nodiscard]] bus::Reply make(Distribution::Peer peer, const ipc::Dictionary& request,
                                const EventRecorder* recorder) const;

 private:
  void addDetails(ipc::Dictionary& values) const;

  const sources::Source& source_;
  const ConfigurationBook& book_;
  const Distribution& distribution_;
  const Distribution::Clock::time_point started_ = Distribution::Clock::now();
};

}  // namespace vespscope::manager
