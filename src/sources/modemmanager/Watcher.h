// Follows ModemManager on one connection to the bus: its start and end, one of its modems, and that modem's SIM card
// and bearers. Used by one thread.
//
// Of several modems it follows the one with the lowest number, until that vanishes.
#pragma once

#include <chrono>
#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <set>
#include <string>

#include "rhoxlink/bus/BusClient.h"
#include "sources/modemmanager/ModemState.h"
#include "sources/modemmanager/ObjectTree.h"
#include "sources/modemmanager/ReadModem.h"

namespace vespscope::sources::modemmanager {

// How often a modem is queried for values that it does not signal.
struct Pace {
  std::chrono::milliseconds location{500};
  std::chrono::milliseconds cells{2000};
  std::chrono::milliseconds retry{10'000};  // after an error
  std::chrono::milliseconds timeout{5000};  // of a call
  std::uint32_t signalSeconds = 1;          // between two measurements, by ModemManager
};

class Watcher {
 public:
  using Clock = std::chrono::steady_clock;

  explicit Watcher(std::unique_ptr<bus::BusClient> bus, Pace pace = {});
  Watcher(const Watcher&) = delete;
  Watcher& operator=(const Watcher&) = delete;
  // Restores the modem's measurement settings.
  ~Watcher();

  // Reads messages and sends requests that are due; returns false when the connection has ended.
  bool work(Clock::time_point now);
  // The condition for the next work().
  [[nodiscard]] bus::Wait wait(Clock::time_point now) const;

  // The modem's state; empty without a modem.
  [[nodiscard]] ModemState state() const;
  // ModemManager, the modem and its activity, in words for a user.
  [[nodiscard]] std::string situation() const;

 private:
  // A request that is repeated.
  struct Question {
    Clock::time_point due;
    bool pending = false;
    bool refused = false;  // the modem does not support it
  };
  using Handler = void (Watcher::*)(const bus::BusClient::Answer&);

  void ownerChanged(const std::string& owner);
  void signalled(const bus::BusSignal& signal);
  void readObjects();
  void chooseModem();
  void followModem(const std::string& path);
  void ask(Clock::time_point now);
  void askSignal(Clock::time_point now);
  void askGathering(Clock::time_point now);
  void askLocation(Clock::time_point now);
  void askCells(Clock::time_point now);
  void askObject(const std::string& path, const std::string& interface, Clock::time_point now);
  bool begin(Question& question, Clock::time_point now, const bus::BusCall& call, bus::BusClient::AnswerHandler done);
  // Logs an error, once per error, and sets when to repeat the request; returns true when the error means that it is
  // not supported.
  void failed(Question& question, const std::string& what, const bus::BusError& error);
  [[nodiscard]] std::optional<std::int32_t> modemState() const;
  [[nodiscard]] bool enabled() const;
  [[nodiscard]] bool signalsLocation() const;

  const Pace pace_;
  ObjectTree tree_;
  std::string owner_;             // the owner of ModemManager's name; empty while it does not run
  bool ownerKnown_ = false;       // the bus has answered
  bool read_ = false;             // ModemManager's objects have been read
  std::string modem_;             // the path of the followed modem
  std::uint64_t modemCount_ = 0;  // modems followed so far: answers for an earlier one are ignored
  std::optional<std::int32_t> lastModemState_;
  Answers answers_;
  std::optional<std::uint32_t> rateFound_;     // of signal measurements, before this program's change
  std::optional<std::uint32_t> sourcesFound_;  // of the location, before this program's change
  Question objects_;
  Question signal_;
  Question gathering_;
  Question location_;
  Question cells_;
  std::map<std::string, Question> details_;  // SIM card and bearers, by path
  std::set<std::string> logged_;
  std::unique_ptr<bus::BusClient> bus_;
};

}  // namespace vespscope::sources::modemmanager
