// One client's connection to the baseband manager, maintained by its own thread.
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
  // Makes the first attempt to connect before it returns, so that commands to a running manager succeed at once.
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
  // Fails all pending calls with `problem`.
  void close(const std::string& problem);
  [[nodiscard]] std::string whyEnded() const;
  // Whether a manager must be started, or another machine reached, before it answers.
  [[nodiscard]] bool takesItsTime() const;
  // Whether to stop reading events for now: many wait here, and no caller waits for an answer that follows them.
  [[nodiscard]] bool heldBack() const { return inbox_->crowded() && !commands_.awaited(); }
  void waitForWork();
  void receive(std::string_view kind, std::uint64_t sequence, vespscope::ipc::Dictionary event);
  void handOverEvents();
  void learnSource(const vespscope::bus::Reply& reply);
  // Stores the facts in the manager's status; a status that changes without commands is requested again after a pause.
  void takeStatus(const vespscope::bus::Reply& reply);
  void askForStatus();

  const std::string name_;
  const vespscope::Result<Address> address_;
  const vespscope::bus::EmbeddedFactory factory_;
  const std::shared_ptr<vespscope::dispatch::SerialQueue> queue_;
  const std::shared_ptr<EventInbox> inbox_;
  const vespscope::dispatch::WakeDescriptor wake_;
  Commands commands_;

  // Used by the connection's thread only, once it runs.
  Link link_;
  std::string refusal_;        // the bus's answer to the first status request if no manager is available
  bool waitsForName_ = false;  // the bus is available, but no manager is on it
  std::chrono::milliseconds backoff_;
  Clock::time_point nextAttempt_;
  Clock::time_point nextQuestion_ = Clock::time_point::max();  // when to request a status that changes without commands
  std::uint64_t nextSequence_ = 1;
  std::vector<EventInbox::Arrived> arrived_;  // not passed on yet
  std::size_t arrivedBytes_ = 0;
  std::uint64_t lost_ = 0;  // events missing before these, from gaps in the sequence

  std::atomic<bool> stopping_ = false;
  mutable std::mutex mutex_;
  ConnectionStatus status_;
  Subscription subscription_;

  std::thread thread_;
};

}  // namespace rhox::client
