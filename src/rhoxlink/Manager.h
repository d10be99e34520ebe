// One client's connection to the baseband manager, kept up by a thread of its own.
#pragma once

#include <chrono>
#include <condition_variable>
#include <cstdint>
#include <deque>
#include <memory>
#include <mutex>
#include <optional>
#include <string>
#include <string_view>
#include <thread>
#include <vector>

#include "platform/dispatch/WakeDescriptor.h"
#include "rhoxlink/Address.h"
#include "rhoxlink/Connector.h"
#include "rhoxlink/EventInbox.h"
#include "rhoxlink/Rhoxlink.h"
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
  void setEvents(bool on);
  [[nodiscard]] ConnectionStatus status() const;

 private:
  using Clock = std::chrono::steady_clock;

  // A command under way; guarded by mutex_.
  struct Call {
    std::string command;
    vespscope::ipc::Dictionary request;
    Clock::time_point deadline;
    std::optional<vespscope::bus::Reply> reply;
    bool abandoned = false;
  };
  // What the connection's thread is asked to send, in order.
  struct Operation {
    std::shared_ptr<Call> call;  // null: turn delivery on or off
    bool on = false;
  };

  void run();
  void connect();
  bool work();
  void sayHello();
  void sendOperations();
  void waitForName();
  void scheduleAttempt();
  void disconnect(const std::string& problem);
  void disconnectOperations(const std::string& problem);
  [[nodiscard]] std::string whyEnded() const;
  [[nodiscard]] bool takesItsTime() const;
  // Whether to leave events to the manager for now: many wait here, and nobody waits for an answer behind them.
  [[nodiscard]] bool heldBack() const { return inbox_->crowded() && sent_.empty(); }
  void waitForWork();
  void receive(std::string_view kind, std::uint64_t sequence, vespscope::ipc::Dictionary event);
  void handOverEvents();
  void finish(const std::shared_ptr<Call>& call, vespscope::bus::Reply reply);
  void learnSource(const vespscope::bus::Reply& reply);
  // Takes what the manager's source is out of its answer; a live one is asked again after a while.
  void takeSource(const vespscope::bus::Reply& reply);
  void askForSource();

  const std::string name_;
  const vespscope::Result<Address> address_;
  const vespscope::bus::EmbeddedFactory factory_;
  const std::shared_ptr<vespscope::dispatch::SerialQueue> queue_;
  const std::shared_ptr<EventInbox> inbox_;
  const vespscope::dispatch::WakeDescriptor wake_;

  // Touched by the connection's thread alone, once it runs.
  Link link_;
  std::string refusal_;        // what the bus said to the greeting, when there is no manager to be had
  bool waitsForName_ = false;  // there is a bus, but no manager on it
  std::deque<std::shared_ptr<Call>> sent_;
  std::chrono::milliseconds backoff_;
  Clock::time_point nextAttempt_;
  Clock::time_point nextQuestion_ = Clock::time_point::max();  // for the source, of a live one
  std::uint64_t nextSequence_ = 1;
  std::vector<EventInbox::Arrived> arrived_;  // not handed over yet
  std::uint64_t lost_ = 0;                    // before these, in gaps of the sequence

  mutable std::mutex mutex_;
  std::condition_variable answered_;
  std::deque<Operation> operations_;
  std::optional<std::int64_t> application_;  // the number that the last command with one carried
  bool linked_ = false;                      // there is an end to send through
  bool delivering_ = false;                  // delivery is wanted, as of the operations sent so far
  bool stopping_ = false;
  ConnectionStatus status_;

  std::thread thread_;
};

}  // namespace rhox::client
