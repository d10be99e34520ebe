// The configurations of the clients' applications: the active ones, and those that are kept across a restart.
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <map>
#include <memory>
#include <optional>

#include "manager/Configuration.h"
#include "manager/ConfigurationKeeper.h"
#include "manager/ConfigurationStore.h"
#include "manager/LogRate.h"
#include "rhoxlink/bus/Bus.h"

namespace vespscope::manager {

// Used by one thread only.
class ConfigurationBook {
 public:
  using Active = std::shared_ptr<const Configuration>;
  using Answer = bus::Service::Answer;

  // The maximum number of applications with a configuration: clients that may configure an application cannot fill the
  // memory or the disk.
  static constexpr std::size_t limit = 64;

  // Configurations in `store` are active from the start; without a store nothing is kept. `answersWait` is called, on
  // any thread, when sendAnswers() has something to do.
  ConfigurationBook(std::optional<ConfigurationStore> store, std::function<void()> answersWait);

  // Makes `toml` the application's configuration, calls `activated` with it and stores it. Answers once it is stored:
  // status 0, with a message if it is active but could not be stored. Answers at once if it is rejected.
  void add(std::int64_t application, const Bytes& toml, const std::function<void(const Active&)>& activated,
           const Answer& answer);
  // Removes the application's configuration, also from the store, and answers likewise.
  void clear(std::int64_t application, const Answer& answer);
  // The application's configuration; null when it has none.
  [[nodiscard]] Active find(std::int64_t application) const;
  [[nodiscard]] const std::map<std::int64_t, Active>& all() const { return active_; }

  // Answers the commands whose configurations have been stored since the last call.
  void sendAnswers();
  // Logs how many log lines were left out; returns when to call it again.
  std::optional<LogRate::Clock::time_point> report(LogRate::Clock::time_point now) { return problems_.report(now); }

 private:
  void load(const ConfigurationStore& store);
  void keep(std::int64_t application, std::optional<Bytes> toml, const Answer& answer);

  LogRate problems_{"problems with kept configurations"};
  std::map<std::int64_t, Active> active_;        // by application
  std::unique_ptr<ConfigurationKeeper> keeper_;  // null: nothing is kept
};

}  // namespace vespscope::manager
