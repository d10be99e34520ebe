// A client of the managers in the storm, a viewer or a recorder, and what each manager says that it was sent.
#pragma once

#include <cstdint>
#include <map>
#include <memory>
#include <optional>
#include <string>

#include "storm/Numbers.h"
#include "storm/Run.h"

namespace vespscope::test {

class Client {
 public:
  enum class Kind { viewer, recorder };

  // Of `number` in the storm; a client `overTheWay` shares it with others that are cut off with it.
  Client(const Place& place, Kind kind, bool overTheWay, unsigned number);

  [[nodiscard]] Run& run() { return *run_; }
  [[nodiscard]] Kind kind() const { return kind_; }
  [[nodiscard]] bool isOverTheWay() const { return overTheWay_; }

  // What a manager counted for this client.
  struct Owed {
    std::uint64_t delivered = 0;
    std::uint64_t lost = 0;
    std::uint64_t sent = 0;      // events of its source
    std::uint64_t withheld = 0;  // events at most that were not for this client, as others configured its metrics again
  };

  // A manager's life that this client sees from its connection to its end, so that everything can be compared.
  void beginLife(Life life) { life_ = life; }
  [[nodiscard]] bool seesLife(Life life) const { return life_ == life; }
  // The life ends without its events being counted.
  void loseLife();
  // The life ends in order. Waits until the events have been taken, and returns what differs, else an empty text.
  [[nodiscard]] std::string settle(const Owed& owed);

  // How the storm ends it, and what must hold then; returns what does not, else an empty text. Only a recorder whose
  // disk is full ends by itself.
  enum class Ending { asked, killed, byItself };
  [[nodiscard]] std::string end(Ending ending);

  // Whether it has come so far that a signal ends it in order.
  [[nodiscard]] bool isReady() const;
  // Whether it is a recorder that ended since there was no manager for it, without leaving a file.
  [[nodiscard]] bool foundNoManager();
  // A full disk for a recorder, from `room` bytes on, which ends it.
  void fillDisk(std::uint64_t room);
  [[nodiscard]] bool hasFullDisk() const { return full_; }
  [[nodiscard]] std::uint64_t count() const { return numbers_.count(); }
  [[nodiscard]] std::uint64_t settledLives() const { return settled_.size(); }

 private:
  void read();
  [[nodiscard]] std::string checkEnd(Ending ending, const ProcessEnd& end) const;
  [[nodiscard]] std::string checkRecording(Ending ending);
  [[nodiscard]] std::string checkNumbers() const;

  Kind kind_;
  bool overTheWay_;
  std::string recording_;  // its path without ".pcap"
  std::unique_ptr<Run> run_;
  Numbers numbers_;
  std::optional<Life> life_;
  std::map<Life, Owed> settled_;
  bool everyLifeSettled_ = true;
  bool full_ = false;  // the disk
};

}  // namespace vespscope::test
