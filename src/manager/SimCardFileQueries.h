// The clients' queries for the SIM card files: the source may find them at once or after a search.
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
  static constexpr std::size_t limit = 64;  // queries that wait for a search, of all clients together

  // Both outlive it, and so does every search that the source has begun.
  SimCardFileQueries(sources::Source& source, Distribution& distribution)
      : source_(source), distribution_(distribution) {}

  // Has the source look for the files for a client that listens for `application`. What it finds at once decides the
  // reply; else the query is accepted, and the event follows when it is found.
  bus::Reply perform(Distribution::Peer peer, std::int64_t application, const ipc::Dictionary& request);
  // Reports the log lines left out; returns when to call it again.
  std::optional<LogRate::Clock::time_point> report(LogRate::Clock::time_point now) { return failures_.report(now); }

 private:
  // A query that is in order.
  struct Query {
    Distribution::Peer peer = 0;
    std::int64_t application = 0;
    std::int64_t profile = 0;
  };
  bool begin();
  bus::Reply find(const Query& query);
  // Queues the files for the client that asked, or says why not.
  bus::Reply give(const Query& query, std::optional<MetricEvent> files);

  sources::Source& source_;
  Distribution& distribution_;
  LogRate failures_{"failed searches for SIM card files"};
  std::mutex mutex_;
  std::size_t waiting_ = 0;  // queries
};

}  // namespace vespscope::manager
