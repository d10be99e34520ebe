// The reply to a status command: the manager's source, its recording, and on request its clients and configurations.
#pragma once

#include "manager/ConfigurationBook.h"
#include "manager/Distribution.h"
#include "manager/EventRecorder.h"
#include "sources/playback/Source.h"

namespace vespscope::manager {

class StatusReport {
 public:
  // All must outlive this object; the manager's running time counts from here.
  StatusReport(const sources::Source& source, const ConfigurationBook& book, const Distribution& distribution)
      : source_(source), book_(book), distribution_(distribution) {}

  // Makes the reply for the client `peer`; `recorder` is null when nothing is recorded.
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
