// The clients' queries for the SIM card files, which the source may find at once or after a search.
#pragma once

#include <cstddef>
#include <cstdint>
#include <mutex>

#include "manager/Distribution.h"
#include "manager/LogRate.h"
#include "sources/playback/Source.h"

namespace vespscope::manager {

class SimCardFileQueries {
 public:
  static constexpr std::size_t limit = 64;  // pending queries of all clients together

  // Both must outlive this object and every search that the source has begun.
  SimCardFileQueries(sources::Source& source, Distribution& distribution)
      : source_(source), distribution_(distribution) {}

  // Makes the source look for the files for a client that listens for `application`. Files found at once decide the
  // reply; otherwise the query is accepted, and the event follows when the files are found.
  bus::Reply perform(Distribution::Peer peer, std::int64_t application, const ipc::Dictionary& request);
  // Logs how many log lines were left out; returns when to call it again.
  std::optional<LogRate::Clock::time_point> report(LogRate::Clock::time_point now) { return failures_.report(now); }

 private:
  // A valid query.
  struct Query {
    Distribution::Peer peer = 0;
    std::int64_t application = 0;
    std::int64_t profile = 0;
  };
  bool begin();
  bus::Reply find(const Query& query);
  // Queues the files for the client that asked, or replies why not.
  bus::Reply give(const Query& query, std::optional<MetricEvent> files);

  sources::Source& source_;
  Distribution& distribution_;
  LogRate failures_{"failed searches for SIM card files"};
  std::mutex mutex_;
  std::size_t waiting_ = 0;  // pending queries
};

}  // namespace vespscope::manager
