// Follows ModemManager on one connection to the bus: its coming and going, one modem of it, and that modem's SIM card
// and bearers. Belongs to one thread.
//
// Of several modems the one with the lowest number is followed, until it vanishes.
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

// How often a modem is asked what it does not signal.
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
  // Leaves the modem's measurements as they were found.
  ~Watcher();

  // Reads what has come and asks what is due; false when the connection is over.
  bool work(Clock::time_point now);
  // What to wait for before the next work().
  [[nodiscard]] bus::Wait wait(Clock::time_point now) const;

  // What the modem tells; nothing without one.
  [[nodiscard]] ModemState state() const;
  // ModemManager, the modem and what it does, for a user's eye.
  [[nodiscard]] std::string situation() const;

 private:
  // A question that is asked again and again.
  struct Question {
    Clock::time_point due;
    bool pending = false;
    bool refused = false;  // the modem does not offer it
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
  // Notes an error for the log, once for each, and when to ask again; true when it means that it is not offered.
  void failed(Question& question, const std::string& what, const bus::BusError& error);
  [[nodiscard]] std::optional<std::int32_t> modemState() const;
  [[nodiscard]] bool enabled() const;
  [[nodiscard]] bool signalsLocation() const;

  const Pace pace_;
  ObjectTree tree_;
  std::string owner_;             // of ModemManager's name; empty while it does not run
  bool ownerKnown_ = false;       // the bus has answered
  bool read_ = false;             // ModemManager's objects have been read
  std::string modem_;             // the path of the modem that is followed
  std::uint64_t modemCount_ = 0;  // modems followed so far: an answer for an earlier one is not taken
  std::optional<std::int32_t> lastModemState_;
  Answers answers_;
  std::optional<std::uint32_t> rateFound_;     // of signal measurements, before ours
  std::optional<std::uint32_t> sourcesFound_;  // of the location, before ours
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
