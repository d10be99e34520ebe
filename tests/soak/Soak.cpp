#include "soak/Soak.h"

#include <algorithm>
#include <chrono>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <thread>
#include <vector>

#include "client/RhoxWrapper.h"
#include "manager/ListeningSocket.h"
#include "platform/application/NavigationController.h"
#include "platform/application/TableSnapshot.h"
#include "platform/dispatch/MainLoop.h"
#include "platform/dispatch/SerialQueue.h"
#include "registry/MetricRows.h"
#include "values/Sanitized.h"

namespace vespscope::test {
namespace {

using namespace std::chrono_literals;
using application::TableViewController;
using dispatch::MainLoop;
using Clock = std::chrono::steady_clock;

constexpr auto patience = 120s;               // for actions that take a moment on an idle machine
constexpr std::uint64_t actions = 2000;       // in a whole run, or fewer in a short one:
constexpr std::uint64_t leastPace = 1000;     // events between two actions
constexpr std::uint64_t missed = 20'000;      // events sent while the viewer is blocked
constexpr std::uint64_t underWay = 2000;      // events in transit, approximately, when a manager is killed
constexpr std::uint64_t mostCut = 16 * 1024;  // the capacity of queue, socket and library for one connection
constexpr long mostGrowth = 16 * 1024;        // KiB
constexpr std::string_view stored = "Received Valid Metric";
constexpr std::string_view ignored = "I dont care for this Metric";

long entriesOf(const char* folder) {
  return static_cast<long>(std::distance(std::filesystem::directory_iterator(folder), {}));
}

Holdings holdings() {
  Holdings holdings;
  std::ifstream file("/proc/self/status");
  for (std::string word; file >> word;) {
    if (word == "VmRSS:") file >> holdings.memory;
  }
  holdings.threads = entriesOf("/proc/self/task");
  holdings.descriptors = entriesOf("/proc/self/fd");
  return holdings;
}

std::string everyEvent() {
  std::string toml = "[metrics]\n";
  for (const MetricRow& row : metricRows) toml += std::string(row.identifierName) + " = { on = \"event\" }\n";
  return toml;
}

}  // namespace

Soak::Soak(std::uint64_t events, std::uint32_t seed, Progress progress)
    : events_(events),
      progress_(std::move(progress)),
      random_(seed),
      load_(seed, events),
      lines_([this](log::Channel channel, std::string_view line) {
        if (channel == log::Channel::standardOutput && (line == stored || line == ignored)) ++stored_;
      }) {}

void Soak::prepare() {
  folder_.write("ice_test_lte.deviceconfig", everyEvent());
  ::setenv("VESPSCOPE_RESOURCES", folder_.path().c_str(), 1);
  rhox::client::setAddress(*rhox::client::Address::parse("unix:path=" + folder_ / "manager"));
  rhox::client::setAfterwards([](std::function<void()> task) { MainLoop::main().async(std::move(task)); });
  load_.pause();
  startManager();
}

void Soak::startManager() {
  server_ = std::make_unique<manager::PeerServer>(load_.makeSource(), manager::ConfigurationStore(folder_ / "state"));
  auto socket = manager::ListeningSocket::at(folder_ / "manager");
  if (!socket) return fail(socket.reason());
  server_->listenOn(std::move(*socket));
  server_->start();
}

int Soak::run(application::Application& application) {
  const Clock::time_point begin = Clock::now();
  const std::uint64_t pace = std::max(events_ / actions, leastPace);
  awaitConnection();
  load_.resume();
  std::uint64_t next = pace;
  std::uint64_t acts = 0;
  while (!load_.isOver() && fault_.empty()) {
    runLoop();
    if (figures_.early.memory == 0 && load_.sent() >= events_ / 10) figures_.early = holdings();
    if (load_.sent() < next) continue;
    act(application);
    next = load_.sent() + pace;
    if (++acts % (actions / 10) == 0) progress_(load_.sent(), holdings());
  }
  if (fault_.empty()) settle();
  figures_.late = holdings();
  if (!sanitized && figures_.late.memory > figures_.early.memory + mostGrowth) {
    fail("memory grew from " + std::to_string(figures_.early.memory) + " to " + std::to_string(figures_.late.memory) +
         " KiB");
  }
  const Counts all = counts();
  figures_.sent = all.sent;
  figures_.stored = all.stored;
  figures_.dropped = all.dropped;
  figures_.seconds = std::chrono::duration<double>(Clock::now() - begin).count();
  if (all.sent != all.stored + all.dropped + figures_.cut) fail("the sums differ");
  return fault_.empty() ? 0 : 1;
}

void Soak::runLoop() {
  MainLoop::main().runOnce(5ms);
  // Lost events count as processed, like stored ones.
  const Counts now = counts();
  load_.setTaken(now.stored + now.dropped + figures_.cut);
}

void Soak::act(application::Application& application) {
  const std::uint64_t choice = draw(100);
  if (choice < 78) return changeScreen(application);
  if (choice < 86) return load_.setPaced(draw(2) == 0);
  if (choice < 90) return standStill();
  if (choice < 95) return relisten();
  if (choice < 98) return restart();
  kill();
}

void Soak::changeScreen(application::Application& application) {
  const auto screen = std::dynamic_pointer_cast<TableViewController>(application.navigation->topViewController());
  const application::TableSnapshot table = application::readTable(*screen);
  std::vector<application::IndexPath> ways;
  for (std::size_t section = 0; section < table.sections.size(); ++section) {
    const auto& rows = table.sections[section].rows;
    figures_.rows += rows.size();
    for (std::size_t row = 0; row < rows.size(); ++row) {
      if (rows[row].disclosure) ways.push_back({section, row});
    }
  }
  const std::size_t depth = application.navigation->viewControllers().size();
  if (ways.empty() || (depth > 1 && draw(3) == 0)) {
    application.navigation->pop();
    return;
  }
  ++figures_.screens;
  application.navigation->selectRow(application.interface, screen, ways[draw(ways.size())]);
}

// Like a viewer that is stopped, or whose terminal accepts no output, while events keep coming.
void Soak::standStill() {
  ++figures_.standstills;
  load_.setPaced(false);
  const std::uint64_t until = load_.sent() + missed;
  const Clock::time_point end = Clock::now() + patience;
  while (load_.sent() < until && !load_.isOver() && Clock::now() < end) std::this_thread::sleep_for(1ms);
}

void Soak::relisten() {
  ++figures_.relistens;
  load_.pause();
  const auto wrapper = RhoxWrapper::sharedInstance();
  wrapper->listen();
  // Its answer comes after the effects of listening.
  ipc::Object reply;
  const auto result = rhox::client::PerformCommand(wrapper->manager(), rhox::kCommandStatus, {}, reply);
  if (result.status != 0) fail("no status: " + result.message);
  load_.resume();
}

void Soak::restart() {
  ++figures_.restarts;
  settle();
  server_.reset();
  startManager();
  awaitConnection();
  checkHoldings();
  load_.resume();
}

void Soak::keepUp() {
  load_.setPaced(true);
  const Clock::time_point end = Clock::now() + patience;
  const auto behind = [this] {
    const Counts passed = counts() - before_;
    return passed.sent - passed.stored - passed.dropped;
  };
  while (behind() > underWay && Clock::now() < end) runLoop();
  load_.setPaced(false);
}

// While events are in transit.
void Soak::kill() {
  ++figures_.kills;
  // A viewer that lags behind has not counted its dropped events yet, and would miss them.
  keepUp();
  const std::uint64_t until = load_.sent() + underWay;
  const Clock::time_point moment = Clock::now() + patience;
  while (load_.sent() < until && !load_.isOver() && Clock::now() < moment) runLoop();
  server_.reset();
  load_.pause();
  const Clock::time_point end = Clock::now() + patience;
  while (status().connected && Clock::now() < end) runLoop();
  // Events that arrived before are still handled.
  const auto queue = RhoxWrapper::sharedInstance()->queue();
  for (int quiet = 0; quiet < 3;) {
    queue->drain();
    quiet = MainLoop::main().runOnce(2ms) ? 0 : quiet + 1;
  }
  const Counts passed = counts() - before_;
  if (passed.sent < passed.stored + passed.dropped || passed.sent - passed.stored - passed.dropped > mostCut) {
    fail("a killed manager cost " + std::to_string(passed.sent - passed.stored - passed.dropped) + " events");
  }
  figures_.cut += passed.sent - passed.stored - passed.dropped;
  startManager();
  awaitConnection();
  checkHoldings();
  load_.resume();
}

rhox::client::ConnectionStatus Soak::status() {
  return rhox::client::connectionStatus(RhoxWrapper::sharedInstance()->manager());
}

void Soak::awaitConnection() {
  ++connections_;
  const Clock::time_point end = Clock::now() + patience;
  while (status().connections < connections_ && Clock::now() < end) runLoop();
  if (status().connections != connections_) fail("connection " + std::to_string(connections_) + " did not come up");
  before_ = counts();
}

void Soak::settle() {
  load_.pause();
  const auto passed = [this] { return counts() - before_; };
  const Clock::time_point end = Clock::now() + patience;
  while (passed().sent != passed().stored + passed().dropped) {
    runLoop();
    if (Clock::now() < end) continue;
    const Counts now = passed();
    return fail(std::to_string(now.sent) + " sent, " + std::to_string(now.stored) + " stored and " +
                std::to_string(now.dropped) + " dropped on one connection");
  }
}

void Soak::checkHoldings() {
  Holdings now = holdings();
  if (!first_) first_ = now;
  // The new manager's source and the end of the old connection take a moment.
  const Clock::time_point end = Clock::now() + patience;
  while ((now.threads != first_->threads || now.descriptors != first_->descriptors) && Clock::now() < end) {
    runLoop();
    now = holdings();
  }
  if (now.threads != first_->threads || now.descriptors != first_->descriptors) {
    fail(std::to_string(now.threads) + " threads and " + std::to_string(now.descriptors) + " descriptors after " +
         std::to_string(connections_) + " connections; at first " + std::to_string(first_->threads) + " and " +
         std::to_string(first_->descriptors));
  }
}

Soak::Counts Soak::counts() const { return {load_.sent(), stored_, status().eventsLost}; }

void Soak::fail(const std::string& what) {
  if (fault_.empty()) fault_ = what;
}

}  // namespace vespscope::test
