#include "storm/Client.h"

#include <charconv>
#include <csignal>
#include <filesystem>
#include <thread>

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;

constexpr auto patience = 30s;  // for what takes a moment on an idle machine
constexpr auto endLimit = 6s;   // from the signal to the end, on a machine that others load

std::vector<std::string> argumentsOf(const Place& place, Client::Kind kind, bool overTheWay, const std::string& file) {
  const std::string manager = "unix:path=" + place / (overTheWay ? "way" : "socket");
  if (kind == Client::Kind::viewer) return {"--ui", "none", "--manager", manager};
  return {"record", file + ".pcap", "--manager", manager};
}

// The number in "vespctl: 17 events were lost"; 0 without such a line.
std::uint64_t lostIn(const std::string& errors) {
  const std::size_t end = errors.rfind(" events were lost");
  if (end == std::string::npos) return 0;
  const std::size_t begin = errors.rfind(' ', end - 1) + 1;
  std::uint64_t lost = 0;
  std::from_chars(errors.data() + begin, errors.data() + end, lost);
  return lost;
}

std::string nameOf(Client::Kind kind, unsigned number) {
  return (kind == Client::Kind::viewer ? "viewer-" : "recorder-") + std::to_string(number);
}

}  // namespace

Client::Client(const Place& place, Kind kind, bool overTheWay, unsigned number)
    : kind_(kind), overTheWay_(overTheWay), recording_(place / nameOf(kind, number)) {
  const std::string program = kind == Kind::viewer ? "vespscope" : "vespctl";
  run_ = std::make_unique<Run>(place, nameOf(kind, number), program, argumentsOf(place, kind, overTheWay, recording_));
}

void Client::loseLife() {
  life_.reset();
  everyLifeSettled_ = false;
}

void Client::read() {
  if (kind_ == Kind::viewer) return numbers_.readLines(run_->newOutput());
  // Each packet is written as it comes.
  numbers_ = {};
  static_cast<void>(numbers_.readCapture(recording_ + ".partial.pcap"));
}

std::string Client::settle(const Owed& owed) {
  const Life life = *life_;
  const Clock::time_point end = Clock::now() + patience;
  for (read(); numbers_.of(life).count < owed.delivered && Clock::now() < end; read())
    std::this_thread::sleep_for(20ms);
  const Arrivals arrivals = numbers_.of(life);
  settled_[life] = owed;
  life_.reset();
  const std::string facts = run_->name() + ": of life " + std::to_string(life) + " it took " +
                            std::to_string(arrivals.count) + " events, " + std::to_string(arrivals.first) + " to " +
                            std::to_string(arrivals.last) + " of " + std::to_string(owed.sent) + ", " +
                            std::to_string(arrivals.missing) + " of these missing; the manager sent it " +
                            std::to_string(owed.delivered) + " and lost " + std::to_string(owed.lost);
  if (arrivals.count != owed.delivered) return facts;
  // Where the first were lost, the range begins behind them.
  if (arrivals.missing + arrivals.first < owed.lost) return facts + ": fewer are missing than were lost";
  if (arrivals.missing > owed.lost + owed.withheld) return facts + ": more are missing than were lost";
  // The newest are never lost.
  if (arrivals.last + 1 != owed.sent) return facts + ": the last did not come";
  return {};
}

std::string Client::checkNumbers() const {
  for (Life life = 0; life < mostLives; ++life) {
    const Arrivals arrivals = numbers_.of(life);
    if (arrivals.misplaced != 0) {
      return run_->name() + ": took " + std::to_string(arrivals.misplaced) + " events of life " + std::to_string(life) +
             " out of order";
    }
    const auto settled = settled_.find(life);
    if (settled != settled_.end() && arrivals.count != settled->second.delivered) {
      return run_->name() + ": holds " + std::to_string(arrivals.count) + " of " +
             std::to_string(settled->second.delivered) + " events of life " + std::to_string(life);
    }
  }
  return {};
}

std::string Client::checkRecording(Ending ending) {
  namespace fs = std::filesystem;
  const std::string whole = recording_ + ".pcap";
  const std::string partial = recording_ + ".partial.pcap";
  const bool isWhole = fs::exists(whole);
  if (!full_ && isWhole != (ending == Ending::asked)) {
    return run_->name() + (isWhole ? ": has its final name without being whole" : ": has no recording");
  }
  if (!isWhole && !fs::exists(partial)) return {};  // it had no event yet
  numbers_ = {};
  const std::optional<std::string> problem = numbers_.readCapture(isWhole ? whole : partial);
  // A kill may come within a packet.
  const bool mayBeCut = ending == Ending::killed;
  if (problem && !(mayBeCut && problem->find("truncated") != std::string::npos)) return *problem;
  if (ending != Ending::asked || full_ || !everyLifeSettled_ || overTheWay_) return {};
  std::uint64_t lost = 0;
  for (const auto& [life, counts] : settled_) lost += counts.lost;
  const std::uint64_t reported = lostIn(run_->errors());
  if (reported == lost) return {};
  return run_->name() + ": reports " + std::to_string(reported) + " lost events, the managers " + std::to_string(lost);
}

bool Client::isReady() const {
  if (kind_ == Kind::viewer) return !run_->output().empty();
  return std::filesystem::exists(recording_ + ".partial.pcap");
}

bool Client::foundNoManager() {
  return kind_ == Kind::recorder && run_->hasEnded() &&
         run_->errors().find("baseband manager: ") != std::string::npos &&
         !std::filesystem::exists(recording_ + ".partial.pcap") && !std::filesystem::exists(recording_ + ".pcap");
}

void Client::fillDisk(std::uint64_t room) {
  std::error_code absent;
  const std::uint64_t size = std::filesystem::file_size(recording_ + ".partial.pcap", absent);
  run_->limitFiles(absent ? room : size + room, Clock::time_point::max());
  full_ = true;
}

std::string Client::checkEnd(Ending ending, const ProcessEnd& end) const {
  const ProcessEnd inOrder{false, 0};
  const ProcessEnd failed{false, 2};
  const ProcessEnd killed{true, SIGKILL};
  const bool expected = ending == Ending::killed     ? end == killed
                        : ending == Ending::byItself ? full_ && end == failed
                                                     : end == inOrder || (full_ && end == failed);
  return expected ? "" : run_->name() + ": ended by " + wordsOf(end) + ": " + run_->errors();
}

std::string Client::end(Ending ending) {
  if (life_) loseLife();
  run_->recover(Clock::time_point::max());
  if (ending == Ending::asked) run_->signal(SIGTERM);
  if (ending == Ending::killed) run_->signal(SIGKILL);
  const std::optional<ProcessEnd> end = run_->waitForEnd(endLimit);
  if (!end) return run_->name() + ": does not end";
  if (std::string fault = checkEnd(ending, *end); !fault.empty()) return fault;
  if (kind_ == Kind::viewer) {
    read();
  } else if (std::string fault = checkRecording(ending); !fault.empty()) {
    return fault;
  }
  return checkNumbers();
}

}  // namespace vespscope::test
