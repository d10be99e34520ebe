// What happens to the programs of the storm.
#include <algorithm>
#include <csignal>
#include <filesystem>
#include <iterator>
#include <thread>

#include "storm/Storm.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
namespace fs = std::filesystem;

}  // namespace

const std::vector<Storm::Fault>& Storm::faults() {
  static const std::vector<Fault> all = {
      {"managers stopped and continued", 3, &Storm::stopManager},
      {"clients stopped and continued", 6, &Storm::stopClient},
      {"clients killed or asked to end", 2, &Storm::endClient},
      {"full disks of managers", 3, &Storm::fillManagersDisk},
      {"full disks of recorders", 1, &Storm::fillRecordersDisk},
      {"connections cut within a message", 4, &Storm::cutTheWay},
      {"connections that stood still", 2, &Storm::standOnTheWay},
      {"attacks", 4, &Storm::attack},
      {"folders of recordings renamed", 1, &Storm::renameFolder},
      {"recordings renamed", 2, &Storm::renameRecording},
      {"folders of configurations removed", 1, &Storm::removeState},
      {"second managers on the socket", 1, &Storm::startAnotherManager},
      {"keys and sizes of the terminal", 6, &Storm::useTerminal},
  };
  return all;
}

void Storm::happen() {
  unsigned all = 0;
  for (const Fault& fault : faults()) all += fault.weight;
  auto drawn = static_cast<unsigned>(draw(1, all));
  for (const Fault& fault : faults()) {
    if (drawn <= fault.weight) {
      count(fault.name);
      (this->*fault.happen)();
      return;
    }
    drawn -= fault.weight;
  }
}

void Storm::stopManager() { manager_->stop(Clock::now() + drawTime(50, 1500)); }

void Storm::stopClient() {
  if (drawOneIn(4)) {
    ::kill(terminal_->program(), SIGSTOP);
    std::this_thread::sleep_for(drawTime(20, 200));
    ::kill(terminal_->program(), SIGCONT);
  } else if (Client* client = drawClient(std::nullopt); client != nullptr && !client->hasFullDisk()) {
    client->run().stop(Clock::now() + drawTime(50, 2000));
  }
}

void Storm::endClient() {
  Client* client = drawClient(std::nullopt);
  if (client == nullptr || !client->isReady()) return;
  const auto place = std::find_if(clients_.begin(), clients_.end(), [&](Client& other) { return &other == client; });
  replaceClient(place, drawOneIn(2) ? Client::Ending::killed : Client::Ending::asked);
}

void Storm::fillManagersDisk() {
  std::error_code absent;
  const std::uint64_t size = fs::file_size(newestRecording(), absent);
  manager_->limitFiles((absent ? 0 : size) + draw(0, 200), Clock::now() + drawTime(50, 1500));
}

void Storm::fillRecordersDisk() {
  Client* client = drawClient(Client::Kind::recorder);
  if (client == nullptr || !client->isReady() || client->hasFullDisk()) return;
  client->loseLife();
  client->fillDisk(draw(0, 200));
}

void Storm::cutTheWay() {
  ++changes_;
  way_.cut();
}

void Storm::standOnTheWay() {
  way_.stand(true);
  wayOpens_ = Clock::now() + drawTime(50, 1000);
}

void Storm::attack() {
  if (attacks_.size() < 3) attacks_.emplace_back(place_ / "socket", draw(0, UINT64_MAX), drawTime(50, 1000));
}

void Storm::renameFolder() {
  std::error_code absent;
  fs::rename(place_ / "recordings", place_ / ("renamed-" + std::to_string(renamed_++)), absent);
}

void Storm::renameRecording() {
  std::error_code absent;
  fs::rename(newestRecording(), place_ / ("renamed-" + std::to_string(renamed_++) + ".pcap"), absent);
}

void Storm::removeState() {
  std::error_code absent;
  fs::remove_all(place_ / "state", absent);
}

// It finds the first one, whatever state that is in, and ends.
void Storm::startAnotherManager() {
  Run other(place_, "other", "rhoxd",
            {"--listen", "unix:path=" + place_ / "socket", "--source", "scenario", "--state", "none"});
  const std::optional<ProcessEnd> end = other.waitForEnd(10s);
  if (!end || *end != ProcessEnd{false, 1}) {
    check("a second manager on the socket " + (end ? "ended by " + wordsOf(*end) : std::string("does not end")) + ": " +
          other.output() + other.errors());
  }
}

void Storm::useTerminal() {
  // None of these leaves the viewer.
  static const std::vector<std::string> keys = {"\r", "\x1b[A", "\x1b[B", "\x1b[5~", "\x1b[6~", "l",
                                                "/",  "rrc",    "\x7f",   "j",       "k",       "?"};
  if (drawOneIn(4)) {
    terminal_->resize(static_cast<unsigned short>(draw(1, 200)), static_cast<unsigned short>(draw(1, 60)));
  }
  terminal_->type(keys[draw(0, keys.size() - 1)]);
  static_cast<void>(terminal_->output());
}

void Storm::startClient(Client::Kind kind, bool overTheWay) {
  count(kind == Client::Kind::viewer ? "viewers" : "recorders");
  ++changes_;
  clients_.emplace_back(place_, kind, overTheWay, started_++);
}

void Storm::replaceClient(std::list<Client>::iterator client, Client::Ending ending) {
  ++changes_;
  checkMemory(client->run());
  check(client->end(ending));
  count("events shown or recorded by clients", client->count());
  const Client::Kind kind = client->kind();
  const bool overTheWay = client->isOverTheWay();
  clients_.erase(client);
  // A recorder needs a manager at its start; the next one has another.
  if (kind == Client::Kind::viewer) startClient(kind, overTheWay);
}

void Storm::watchClients() {
  for (auto client = clients_.begin(); client != clients_.end();) {
    const auto next = std::next(client);
    if (client->foundNoManager()) {
      clients_.erase(client);
    } else if (client->run().hasEnded()) {
      replaceClient(client, Client::Ending::byItself);
    }
    client = next;
  }
  if (manager_->hasEnded()) check(manager_->name() + " has ended: " + manager_->errors());
  if (const std::optional<int> end = terminal_->waitForEnd(0ms)) {
    check("the terminal's viewer has ended by status " + std::to_string(*end) + ": " + terminal_->output());
  }
}

void Storm::recover(bool everything) {
  const Clock::time_point now = everything ? Clock::time_point::max() : Clock::now();
  if (manager_) manager_->recover(now);
  for (Client& client : clients_) {
    if (!client.hasFullDisk()) client.run().recover(now);
  }
  if (wayOpens_ && *wayOpens_ <= now) {
    way_.stand(false);
    wayOpens_.reset();
  }
  if (everything) {
    attacks_.clear();
  } else {
    attacks_.remove_if([](const Attack& attack) { return attack.isOver(); });
  }
}

Client* Storm::drawClient(std::optional<Client::Kind> kind) {
  std::vector<Client*> choice;
  for (Client& client : clients_) {
    if (!kind || client.kind() == *kind) choice.push_back(&client);
  }
  return choice.empty() ? nullptr : choice[draw(0, choice.size() - 1)];
}

std::string Storm::newestRecording() const {
  std::string newest;
  std::error_code absent;
  for (const fs::directory_entry& entry : fs::directory_iterator(place_ / "recordings", absent)) {
    const std::string path = entry.path().string();
    if (path.ends_with(".pcap")) newest = std::max(newest, path);
  }
  return newest;
}

}  // namespace vespscope::test
