// A fault storm: a manager that records, viewers and recorders run while they are killed, stopped, flooded, cut off,
// renamed under and kept from writing, in turns drawn by a seed; then every event is accounted for.
#pragma once

#include <chrono>
#include <cstdint>
#include <list>
#include <map>
#include <memory>
#include <optional>
#include <random>
#include <string>
#include <vector>

#include <nlohmann/json.hpp>

#include "storm/Attack.h"
#include "storm/Client.h"
#include "storm/Numbers.h"
#include "storm/Run.h"
#include "storm/Way.h"
#include "support/Pty.h"

namespace vespscope::test {

class Storm {
 public:
  // Works in `place`, which stays as it is afterwards.
  Storm(Place place, std::uint64_t seed, std::chrono::seconds length);
  Storm(const Storm&) = delete;
  Storm& operator=(const Storm&) = delete;
  ~Storm();

  // Returns the finding; an empty text when everything held.
  [[nodiscard]] std::string run();

  // What happened, how often.
  [[nodiscard]] const std::map<std::string, std::uint64_t>& figures() const { return figures_; }

 private:
  struct Fault {
    const char* name;
    unsigned weight;
    void (Storm::*happen)();
  };
  static const std::vector<Fault>& faults();

  // One manager, from its start to its end.
  void live();
  void startManager();
  void admitClients();
  void happen();
  void endLife();
  void settleLife();
  void endManager(bool killed);
  void finish();

  // Faults.
  void stopManager();
  void stopClient();
  void endClient();
  void fillManagersDisk();
  void fillRecordersDisk();
  void cutTheWay();
  void standOnTheWay();
  void attack();
  void renameFolder();
  void renameRecording();
  void removeState();
  void startAnotherManager();
  void useTerminal();

  void startClient(Client::Kind kind, bool overTheWay);
  void replaceClient(std::list<Client>::iterator client, Client::Ending ending);
  void watchClients();
  void recover(bool everything);
  void checkRecordings();
  void checkProcesses();
  void checkTerminal();
  void checkMemory(const Run& run);
  // The manager's answer; null when it gives none in time.
  [[nodiscard]] nlohmann::json status();
  [[nodiscard]] nlohmann::json statusOf(pid_t client);
  [[nodiscard]] std::string newestRecording() const;

  [[nodiscard]] std::uint64_t draw(std::uint64_t from, std::uint64_t to) {
    return std::uniform_int_distribution<std::uint64_t>(from, to)(random_);
  }
  [[nodiscard]] bool drawOneIn(std::uint64_t count) { return draw(1, count) == 1; }
  [[nodiscard]] std::chrono::milliseconds drawTime(std::uint64_t from, std::uint64_t to) {
    return std::chrono::milliseconds(draw(from, to));
  }
  [[nodiscard]] Client* drawClient(std::optional<Client::Kind> kind);
  void count(const std::string& what, std::uint64_t more = 1) { figures_[what] += more; }
  // Keeps the first finding only.
  void check(const std::string& fault) {
    if (finding_.empty()) finding_ = fault;
  }

  const Place place_;
  const std::chrono::seconds length_;
  std::mt19937_64 random_;
  Way way_;
  std::list<Client> clients_;
  unsigned started_ = 0;  // clients
  std::unique_ptr<Pty> terminal_;
  std::unique_ptr<Run> manager_;
  std::list<Attack> attacks_;
  std::optional<Clock::time_point> wayOpens_;
  Life life_ = 0;
  std::uint32_t rate_ = 0;     // events of this life in a second
  std::uint32_t events_ = 0;   // of this life
  std::uint64_t changes_ = 0;  // in this life, of clients, each of which configures metrics for a moment in another way
  std::vector<std::uint32_t> sent_;         // events of each life
  std::map<Life, std::uint64_t> recorded_;  // events of the lives that ended calmly, in the manager's recording
  bool killed_ = false;                     // a manager, which may leave a recording that ends within a packet
  unsigned renamed_ = 0;
  unsigned questions_ = 0;
  std::map<std::string, std::uint64_t> figures_;
  std::string finding_;
};

}  // namespace vespscope::test
