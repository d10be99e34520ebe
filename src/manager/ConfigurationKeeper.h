// Writes configurations to the store on its own thread: a slow disk delays only the clients that wait for the answer.
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
  // Writes what is queued without calling `done`.
  ~ConfigurationKeeper();

  // Queues the application's configuration to be written, or removed. Of several queued for one application only the
  // newest is written; `done` is called once that or a newer one is written.
  void keep(std::int64_t application, std::optional<Bytes> configuration, Done done);
  // Calls `done` of the configurations written since the last call.
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
  std::deque<std::int64_t> order_;           // of those applications, in the order of writing
  std::vector<std::pair<Done, Problem>> done_;
  bool stopping_ = false;
  std::thread thread_;
};

}  // namespace vespscope::manager
