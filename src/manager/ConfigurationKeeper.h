// Writes configurations to where they are kept on a thread of its own: a slow disk delays nobody but the clients that
// wait for the answer.
#pragma once

#include <condition_variable>
#include <cstdint>
#include <deque>
#include <functional>
#include <map>
#include <mutex>
#include <optional>
#include <string>
#include <thread>
#include <utility>
#include <vector>

#include "values/Value.h"

namespace vespscope::manager {

class ConfigurationKeeper {
 public:
  using Problem = std::optional<std::string>;
  // Writes the application's configuration, or removes it when there is none; returns the reason on failure.
  using Write = std::function<Problem(std::int64_t application, const std::optional<Bytes>& configuration)>;
  using Done = std::function<void(const Problem&)>;

  // `doneWait` is called on the keeper's thread when callDone() has something to do.
  ConfigurationKeeper(Write write, std::function<void()> doneWait);
  ConfigurationKeeper(const ConfigurationKeeper&) = delete;
  ConfigurationKeeper& operator=(const ConfigurationKeeper&) = delete;
  // Writes what waits; its `done` is not called.
  ~ConfigurationKeeper();

  // Has the application's configuration written, or removed. Of those that wait for their turn the newest of each
  // application is written; `done` is called once that or a newer one is.
  void keep(std::int64_t application, std::optional<Bytes> configuration, Done done);
  // Calls `done` of what has been written since the last call.
  void callDone();

 private:
  struct Waiting {
    std::optional<Bytes> configuration;
    std::vector<Done> done;
  };
  void run();

  const Write write_;
  const std::function<void()> doneWait_;
  std::mutex mutex_;
  std::condition_variable changed_;
  std::map<std::int64_t, Waiting> waiting_;  // by application
  std::deque<std::int64_t> order_;           // of those applications: first come, first written
  std::vector<std::pair<Done, Problem>> done_;
  bool stopping_ = false;
  std::thread thread_;
};

}  // namespace vespscope::manager
