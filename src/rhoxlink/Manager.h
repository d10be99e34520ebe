// One client's connection to the baseband manager, kept up by a thread of its own.
#pragma once

#include <atomic>
#include <chrono>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <mutex>
#include <string>
#include <string_view>
#include <thread>
#include <vector>

#include "platform/dispatch/WakeDescriptor.h"
#include "rhoxlink/Address.h"
#include "rhoxlink/Commands.h"
#include "rhoxlink/Connector.h"
#include "rhoxlink/EventInbox.h"
#include "rhoxlink/Rhoxlink.h"
#include "rhoxlink/Subscription.h"
#include "rhoxlink/bus/Bus.h"

namespace rhox::client {

class Manager {
 public:
  // Makes the first attempt to connect before it returns, so that a manager that is there can be commanded at once.
  Manager(std::string name, vespscope::Result<Address> address, vespscope::bus::EmbeddedFactory factory,
          std::shared_ptr<vespscope::dispatch::SerialQueue> queue, Afterwards afterwards);
  Manager(const Manager&) = delete;
  Manager& operator=(const Manager&) = delete;
  ~Manager();

  Result perform(std::string_view command, const vespscope::ipc::Dictionary& request, vespscope::ipc::Object& reply,
                 std::chrono::milliseconds timeout);
  void setHandler(std::string_view event, EventHandler handler) { inbox_->setHandler(event, std::move(handler)); }
  void setObserver(std::string_view event, EventObserver observer);
  void setEvents(bool on) { commands_.setEvents(on); }
  [[nodiscard]] ConnectionStatus status() const;

 private:
  using Clock = Commands::Clock;

  void run();
  void connect();
  bool work();
  void sayHello();
  void giveConfigurations();
  void sendOperations();
  void send(const Commands::Operation& operation);
  void waitForName();
  void scheduleAttempt();
  void disconnect(const std::string& problem);
  // Ends what was under way, with `problem` as the reason.
  void close(const std::string& problem);
  [[nodiscard]] std::string whyEnded() const;
  // Whether a manager is started, or another machine reached, before it answers.
  [[nodiscard]] bool takesItsTime() const;
  // Whether to leave events to the manager for now: many wait here, and nobody waits for an answer behind them.
  [[nodiscard]] bool heldBack() const { return inbox_->crowded() && !commands_.awaited(); }
  void waitForWork();
  void receive(std::string_view kind, std::uint64_t sequence, vespscope::ipc::Dictionary event);
  void handOverEvents();
  void learnSource(const vespscope::bus::Reply& reply);
  // Takes what the manager's status says; one that changes by itself is asked for again after a while.
  void takeStatus(const vespscope::bus::Reply& reply);
  void askForStatus();

  const std::string name_;
  const vespscope::Result<Address> address_;
  const vespscope::bus::EmbeddedFactory factory_;
  const std::shared_ptr<vespscope::dispatch::SerialQueue> queue_;
  const std::shared_ptr<EventInbox> inbox_;
  const vespscope::dispatch::WakeDescriptor wake_;
  Commands commands_;

  // Touched by the connection's thread alone, once it runs.
  Link link_;
  std::string refusal_;        // how the bus answered the greeting, when no manager is available
  bool waitsForName_ = false;  // there is a bus, but no manager on it
  std::chrono::milliseconds backoff_;
  Clock::time_point nextAttempt_;
  Clock::time_point nextQuestion_ = Clock::time_point::max();  // for the status, where it changes by itself
  std::uint64_t nextSequence_ = 1;
  std::vector<EventInbox::Arrived> arrived_;  // not handed over yet
  std::size_t arrivedBytes_ = 0;
  std::uint64_t lost_ = 0;  // before these, in gaps of the sequence

  std::atomic<bool> stopping_ = false;
  mutable std::mutex mutex_;
  ConnectionStatus status_;
  Subscription subscription_;

  std::thread thread_;
};

}  // namespace rhox::client
