#include "storm/Storm.h"

#include <termios.h>

#include <algorithm>
#include <array>
#include <csignal>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <functional>
#include <thread>
#include <utility>

#include "values/Sanitized.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using nlohmann::json;
namespace fs = std::filesystem;

constexpr auto patience = 30s;          // for what takes a moment on an idle machine
constexpr auto endLimit = 6s;           // from the signal to the end, on a machine that others load
constexpr auto turn = 20ms;             // of the storm
constexpr std::uint64_t calmLives = 2;  // of three
constexpr long mostMemory = 64 * 1024;  // KiB, of any program

bool eventually(const std::function<bool()>& condition, std::chrono::milliseconds limit = patience) {
  const Clock::time_point end = Clock::now() + limit;
  while (!condition()) {
    if (Clock::now() >= end) return false;
    std::this_thread::sleep_for(turn);
  }
  return true;
}

}  // namespace

Storm::Storm(Place place, std::uint64_t seed, std::chrono::seconds length)
    : place_(std::move(place)), length_(length), random_(seed), way_(place_ / "way", place_ / "socket") {
  std::ofstream(place_ / "ice_test_lte.deviceconfig") << "[metrics]\nK_LTE_RRC_STATE = { on = \"event\" }\n";
  ::setenv("VESPSCOPE_RESOURCES", place_.folder.c_str(), 1);
}

// An attack may wait for a manager that is stopped.
Storm::~Storm() { recover(true); }

std::string Storm::run() {
  const Clock::time_point end = Clock::now() + length_;
  startClient(Client::Kind::viewer, false);
  startClient(Client::Kind::viewer, true);
  terminal_ = std::make_unique<Pty>(std::vector<std::string>{
      (place_.programs / "vespscope").string(), "--ui", "terminal", "--manager", "unix:path=" + place_ / "socket"});
  while (Clock::now() < end && finding_.empty()) live();
  if (finding_.empty()) finish();
  return finding_;
}

void Storm::live() {
  startManager();
  if (!finding_.empty()) return;
  admitClients();
  const Clock::time_point end = Clock::now() + drawTime(1000, 4000);
  Clock::time_point next = Clock::now();
  while (Clock::now() < end && finding_.empty()) {
    if (Clock::now() >= next) {
      happen();
      next = Clock::now() + drawTime(20, 400);
    }
    recover(false);
    watchClients();
    std::this_thread::sleep_for(turn);
  }
  if (finding_.empty()) endLife();
}

void Storm::startManager() {
  // Some events in a second, and as many as last about as long as the life.
  rate_ = std::array<std::uint32_t, 4>{50, 500, 3000, 20'000}.at(draw(0, 3));
  events_ = rate_ * static_cast<std::uint32_t>(draw(1, 4));
  changes_ = clients_.size() + 1;  // they all connect, and so does the terminal's
  life_ = static_cast<Life>(sent_.size());
  sent_.push_back(events_);
  const std::string source = place_ / ("source-" + std::to_string(life_) + ".pcap");
  writeSource(source, life_, events_, rate_);
  count("managers");
  manager_ = std::make_unique<Run>(
      place_, "manager-" + std::to_string(life_), "rhoxd",
      std::vector<std::string>{"--listen", "unix:path=" + place_ / "socket", "--source", "replay:" + source, "--state",
                               place_ / "state", "--record", place_ / "recordings", "--record-size", "32K"});
  if (!eventually([this] { return !manager_->output().empty() || manager_->hasEnded(); }) || manager_->hasEnded()) {
    check("manager " + std::to_string(life_) + " does not start: " + manager_->errors());
  }
}

// Those that are connected before anything happens see the whole life.
void Storm::admitClients() {
  const auto recorders = std::count_if(clients_.begin(), clients_.end(),
                                       [](Client& client) { return client.kind() == Client::Kind::recorder; });
  if (recorders < 2) startClient(Client::Kind::recorder, drawOneIn(3));
  const auto connected = [this](Client& client) {
    if (client.isOverTheWay()) return true;
    const json entry = statusOf(client.run().identifier());
    // It listens before its configuration is there.
    return entry.value("listening", false) && entry.value("delivered", 0U) != 0;
  };
  // A viewer's next attempt may take a moment; one that is later sees the next life.
  eventually([&] { return std::all_of(clients_.begin(), clients_.end(), connected); }, 3s);
  for (Client& client : clients_) {
    if (!client.isOverTheWay() && connected(client)) client.beginLife(life_);
  }
}

void Storm::endLife() {
  const std::uint64_t ending = draw(1, 4);
  if (ending <= calmLives) {
    settleLife();
    endManager(false);
  } else {
    for (Client& client : clients_) client.loseLife();
    endManager(ending == calmLives + 1);
  }
}

void Storm::settleLife() {
  recover(true);
  json answer;
  const auto over = [&] {
    answer = status();
    return answer.is_object() && answer.value("recorded", 0U) + answer.value("recording_lost", 0U) >= events_;
  };
  if (!eventually(over, patience + 10s)) {
    return check("life " + std::to_string(life_) + ": of " + std::to_string(events_) +
                 " events neither all are recorded nor lost: " + answer.dump());
  }
  if (answer.value("recorded", 0U) + answer.value("recording_lost", 0U) != events_) {
    return check("life " + std::to_string(life_) + ": the recording's counts differ: " + answer.dump());
  }
  recorded_[life_] = answer.value("recorded", 0U);
  count("lives that ended calmly");
  count("events sent in them", events_);
  count("events recorded in them", recorded_[life_]);
  count("events lost to the recording in them", answer.value("recording_lost", 0U));
  for (Client& client : clients_) {
    if (!client.seesLife(life_)) {
      client.loseLife();
      continue;
    }
    json entry;
    const auto taken = [&] {
      entry = statusOf(client.run().identifier());
      return entry.is_object() && entry.value("queued", 1U) == 0;
    };
    if (!eventually(taken)) return check(client.run().name() + ": does not take its events: " + entry.dump());
    check(client.settle({.delivered = entry.value("delivered", 0U),
                         .lost = entry.value("lost", 0U),
                         .sent = events_,
                         .withheld = changes_ * rate_}));
    count("clients' lives accounted for");
    count("events delivered in them", entry.value("delivered", 0U));
    count("events counted as lost in them", entry.value("lost", 0U));
  }
}

void Storm::endManager(bool killed) {
  checkMemory(*manager_);
  if (killed) {
    count("managers killed");
    killed_ = true;
    manager_->signal(SIGKILL);
    static_cast<void>(manager_->waitForEnd(endLimit));
    recover(true);
    return;
  }
  // A stopped process takes no signal.
  manager_->recover(Clock::time_point::max());
  manager_->signal(SIGTERM);
  const std::optional<ProcessEnd> end = manager_->waitForEnd(endLimit);
  if (!end || *end != ProcessEnd{false, 0}) {
    check(manager_->name() + (end ? ": ended by " + wordsOf(*end) : ": does not end") + ": " + manager_->errors());
  }
  recover(true);
}

void Storm::finish() {
  startManager();
  recover(true);
  attacks_.clear();
  checkTerminal();
  endManager(false);
  while (!clients_.empty() && finding_.empty()) {
    Client& client = clients_.front();
    if (!client.foundNoManager()) {
      checkMemory(client.run());
      check(client.end(Client::Ending::asked));
    }
    count("events shown or recorded by clients", client.count());
    clients_.pop_front();
  }
  if (finding_.empty()) checkRecordings();
  if (finding_.empty()) checkProcesses();
}

void Storm::checkTerminal() {
  terminal_->type("\x1b");
  static_cast<void>(terminal_->output());
  ::kill(terminal_->program(), SIGTERM);
  std::optional<int> end;
  // It is read from, as a terminal does.
  eventually(
      [&] {
        static_cast<void>(terminal_->output());
        end = terminal_->waitForEnd(0ms);
        return end.has_value();
      },
      endLimit);
  if (!end) return check("the terminal's viewer does not end");
  if (*end != 0) return check("the terminal's viewer ended by status " + std::to_string(*end));
  const std::string& output = terminal_->output();
  if (output.rfind("\x1b[?1049l") == std::string::npos || (terminal_->modes().c_lflag & (ICANON | ECHO)) == 0) {
    check("the terminal is not restored");
  }
}

void Storm::checkRecordings() {
  Numbers numbers;
  for (const fs::directory_entry& entry : fs::directory_iterator(place_.folder)) {
    const std::string name = entry.path().filename().string();
    if (!name.starts_with("recordings") && !name.starts_with("renamed")) continue;
    const std::optional<std::string> problem = numbers.readCapture(entry.path().string());
    if (problem && problem->find("holds no captures") == std::string::npos &&
        (!killed_ || problem->find("truncated") == std::string::npos)) {
      return check(*problem);
    }
  }
  for (const auto& [life, recorded] : recorded_) {
    const std::uint64_t found = numbers.of(life).count;
    if (found == recorded) continue;
    return check("life " + std::to_string(life) + ": " + std::to_string(recorded) + " events are recorded, and " +
                 std::to_string(found) + " found");
  }
  count("events in the managers' recordings", numbers.count());
}

void Storm::checkProcesses() {
  // Of ours, one would have the folder's name among its arguments.
  for (const fs::directory_entry& entry : fs::directory_iterator("/proc")) {
    const std::string words = contentsOf((entry.path() / "cmdline").string());
    if (words.find(place_.folder.string() + "/") != std::string::npos) {
      std::string line = words;
      std::replace(line.begin(), line.end(), '\0', ' ');
      check("a process is left: " + line);
    }
  }
}

void Storm::checkMemory(const Run& run) {
  const long memory = run.memory();
  figures_["most memory of a program (KiB)"] =
      std::max(figures_["most memory of a program (KiB)"], static_cast<std::uint64_t>(memory));
  if (!sanitized && memory > mostMemory) check(run.name() + ": took " + std::to_string(memory) + " KiB");
}

json Storm::status() {
  const std::string name = "status-" + std::to_string(questions_++ % 4);
  Run question(place_, name, "vespctl", {"status", "--manager", "unix:path=" + place_ / "socket"});
  if (!question.waitForEnd(patience)) return nullptr;
  return json::parse(question.output(), nullptr, false);
}

json Storm::statusOf(pid_t client) {
  const json answer = status();
  if (!answer.is_object()) return json::object();
  for (const json& entry : answer.value("clients", json::array())) {
    if (entry.value("process", 0) == client) return entry;
  }
  return json::object();
}

}  // namespace vespscope::test
