// The configurations of the clients' applications: which are active, and which of them are kept beyond a restart.
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

// Belongs to one thread.
class ConfigurationBook {
 public:
  using Active = std::shared_ptr<const Configuration>;
  using Answer = bus::Service::Answer;

  // Applications with a configuration at a time: clients that may configure one can fill neither the memory nor the
  // disk where configurations are kept.
  static constexpr std::size_t limit = 64;

  // What `store` keeps is active from the start; without one nothing is kept. `answersWait` is called, on any thread,
  // when sendAnswers() has something to do.
  ConfigurationBook(std::optional<ConfigurationStore> store, std::function<void()> answersWait);

  // Makes `toml` the application's configuration and calls `activated` with it, then has it kept. Answers once it is
  // kept: status 0, with a message when it is active but could not be kept; at once when it is refused.
  void add(std::int64_t application, const Bytes& toml, const std::function<void(const Active&)>& activated,
           const Answer& answer);
  // Removes the application's configuration, also the kept one, and answers likewise.
  void clear(std::int64_t application, const Answer& answer);
  // The application's configuration; null when it has none.
  [[nodiscard]] Active find(std::int64_t application) const;
  [[nodiscard]] const std::map<std::int64_t, Active>& all() const { return active_; }

  // Answers those whose configurations have been kept since the last call.
  void sendAnswers();
  // Reports the log lines left out; returns when to call it again.
  std::optional<LogRate::Clock::time_point> report(LogRate::Clock::time_point now) { return problems_.report(now); }

 private:
  void load(const ConfigurationStore& store);
  void keep(std::int64_t application, std::optional<Bytes> toml, const Answer& answer);

  LogRate problems_{"problems with kept configurations"};
  std::map<std::int64_t, Active> active_;        // by application
  std::unique_ptr<ConfigurationKeeper> keeper_;  // null: nothing is kept
};

}  // namespace vespscope::manager
