// The whole viewer under a load, with random changes of screens, deliveries turned off and on, and managers that are
// restarted or killed: accounts for every event, and monitors the process's resources.
#pragma once

#include <array>
#include <atomic>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <random>
#include <string>

#include "manager/PeerServer.h"
#include "platform/application/Application.h"
#include "platform/log/Log.h"
#include "rhoxlink/Rhoxlink.h"
#include "soak/Load.h"
#include "support/TemporaryFolder.h"

namespace vespscope::test {

// The process's resources.
struct Holdings {
  long memory = 0;  // resident, KiB
  long threads = 0;
  long descriptors = 0;
};

struct Figures {
  std::uint64_t sent = 0;     // by the sources
  std::uint64_t stored = 0;   // received by the decoder, whether or not it stores that metric
  std::uint64_t dropped = 0;  // and counted as lost where the user sees it
  std::uint64_t cut = 0;      // in transit to the viewer when a manager was killed
  std::uint64_t restarts = 0;
  std::uint64_t kills = 0;
  std::uint64_t relistens = 0;
  std::uint64_t standstills = 0;
  std::uint64_t screens = 0;  // opened
  std::uint64_t rows = 0;     // read from them
  Holdings early;             // after a tenth of the events
  Holdings late;
  double seconds = 0;
};

class Soak final : public application::Frontend {
 public:
  // Called at intervals with the number of events sent and the resources.
  using Progress = std::function<void(std::uint64_t sent, const Holdings& held)>;

  Soak(std::uint64_t events, std::uint32_t seed, Progress progress);

  // Puts the configuration that selects every event where the viewer looks for it, and starts the first manager.
  void prepare();
  int run(application::Application& application) override;

  [[nodiscard]] const Figures& figures() const { return figures_; }
  // The first violated condition; empty if there is none.
  [[nodiscard]] const std::string& fault() const { return fault_; }

 private:
  struct Counts {
    std::uint64_t sent = 0;
    std::uint64_t stored = 0;
    std::uint64_t dropped = 0;
    friend Counts operator-(const Counts& one, const Counts& other) {
      return {one.sent - other.sent, one.stored - other.stored, one.dropped - other.dropped};
    }
  };

  void startManager();
  void act(application::Application& application);
  void changeScreen(application::Application& application);
  void standStill();
  void relisten();
  void restart();
  // Runs until the viewer has nearly caught up.
  void keepUp();
  void kill();
  void awaitConnection();
  // Runs the viewer until every event of this connection is accounted for.
  void settle();
  void checkHoldings();
  void runLoop();
  [[nodiscard]] static rhox::client::ConnectionStatus status();
  [[nodiscard]] Counts counts() const;
  void fail(const std::string& what);
  std::uint64_t draw(std::uint64_t below) {
    return std::uniform_int_distribution<std::uint64_t>(0, below - 1)(random_);
  }

  const std::uint64_t events_;
  const Progress progress_;
  std::mt19937_64 random_;
  Load load_;
  TemporaryFolder folder_;
  std::unique_ptr<manager::PeerServer> server_;
  std::atomic<std::uint64_t> stored_ = 0;
  log::Observation lines_;
  Counts before_;  // when this connection began
  std::uint64_t connections_ = 0;
  std::optional<Holdings> first_;
  Figures figures_;
  std::string fault_;
};

}  // namespace vespscope::test
